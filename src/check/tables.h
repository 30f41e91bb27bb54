#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "erp/company_database.h"

namespace zebtell::check {

// What the company database would say to a template, asked in the words that pages use and without
// reading any data. Without a database nothing is known to be wrong.
class Tables {
  public:
    explicit Tables(const erp::CompanyDatabase* database) : database_(database) {}

    // Whether a record of `table` has the column or dotted path.
    bool HasField(std::string_view table, std::string_view field) const;
    // Whether the field holds text, which may hold any character.
    bool IsText(std::string_view table, std::string_view field) const;

    // What is wrong with a list of a table, or with a select statement; nothing when it is right.
    std::optional<std::string> ListFault(std::string_view table,
                                         std::string_view filter,
                                         std::string_view order) const;
    std::optional<std::string> SelectFault(std::string_view sql) const;

  private:
    const erp::CompanyDatabase* database_;
};

}  // namespace zebtell::check
