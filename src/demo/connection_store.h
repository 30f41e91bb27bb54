#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "demo/company_store.h"
#include "erp/connection.h"

namespace zebtell::demo {

// A database on a server that is being filled in one transaction: tables first, rows many at a
// time, links, indexes and views last. Nothing of it is there unless Finish returns.
class ConnectionStore : public CompanyStore {
  public:
    // RuntimeError kInvalidCall unless the database is empty.
    explicit ConnectionStore(erp::Backend& backend);
    ~ConnectionStore() override;

    RowWriter& Table(std::string_view name, const std::vector<std::string_view>& columns) override;
    void Finish();

  private:
    class TableRows;

    void RunScript(std::string_view script);

    erp::Dialect dialect_;
    std::unique_ptr<erp::Connection> connection_;
    std::vector<std::unique_ptr<TableRows>> tables_;
};

// The statements of a script, of which each ends with a semicolon at the end of its line; lines of
// comment are left out.
std::vector<std::string> StatementsOf(std::string_view script);

}  // namespace zebtell::demo
