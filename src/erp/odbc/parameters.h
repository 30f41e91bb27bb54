#pragma once

#include <cstdint>
#include <deque>
#include <vector>

#include "base/value.h"
#include "erp/odbc/api.h"
#include "erp/odbc/link.h"

namespace zebtell::erp::odbc {

// The values of a statement, in the form and at the place where the driver reads them while the
// statement runs. Their types come from the values: drivers need not know those of the parameters.
class Parameters {
  public:
    void Bind(Link& link, SQLHSTMT statement, const std::vector<base::Value>& values);

  private:
    struct Slot {
        SQLLEN length = 0;
        std::int64_t integer = 0;
        double number = 0;
        unsigned char bit = 0;
        SQL_TIMESTAMP_STRUCT time{};
        std::string digits;
        std::u16string text;
    };
    struct Type {
        SQLSMALLINT c_type;
        SQLSMALLINT sql_type;
        SQLULEN size;
        SQLSMALLINT scale;
        SQLPOINTER data;
        SQLLEN bytes;
    };

    static Type Fill(Slot& slot, const base::Value& value, bool loose_types);
    static Type FillText(Slot& slot, const std::string& text);
    static Type FillDigits(Slot& slot, std::string digits);
    static Type FillTime(Slot& slot, const base::DateTime& time);

    std::deque<Slot> slots_;
};

}  // namespace zebtell::erp::odbc
