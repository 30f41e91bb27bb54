#include "erp/odbc/cell.h"

#include <gtest/gtest.h>

#include "erp/odbc/utf16.h"

namespace zebtell::erp::odbc {
namespace {

using base::Currency;
using base::Value;

TEST(CellTest, DecimalsAreReadFromTheirDigits) {
    const struct {
        const char* type_name;
        SQLSMALLINT sql_type;
        SQLSMALLINT scale;
        const char* digits;
        Value value;
    } rows[] = {
        {"money",
         SQL_DECIMAL,
         4,
         "922337203685477.5807",
         Currency::FromScaled(9223372036854775807)},
        {"decimal", SQL_DECIMAL, 2, "-0.10", Currency::FromText("-0.1")},
        {"decimal", SQL_DECIMAL, 6, "1.123456", 1.123456},
        {"numeric", SQL_NUMERIC, 3, " 2.500", 2.5},
        {"numeric() identity", SQL_NUMERIC, 0, "", Value::Null()},
    };
    for (const auto& row : rows) {
        const ResultColumn column =
            MakeResultColumn("x", {row.type_name, row.sql_type, 19, row.scale}, false);
        if (column.wire != Wire::kDigits) {
            EXPECT_EQ(column.type, ColumnType::kInteger) << row.type_name;
            continue;
        }
        const std::string digits = row.digits;
        EXPECT_EQ(ReadCell(column,
                           reinterpret_cast<const std::byte*>(digits.data()),
                           static_cast<SQLLEN>(digits.size())),
                  row.value)
            << row.digits;
    }
}

TEST(CellTest, Utf16IsTakenApartAndPutTogether) {
    const std::string text = "aõ€\xF0\x9F\x94\xA9";
    EXPECT_EQ(ToUtf16(text), u"aõ€\U0001F529");
    EXPECT_EQ(FromUtf16(u"aõ€\U0001F529"), text);
    const char16_t halves[] = {0xD83D, u'x', 0xDD29};
    EXPECT_EQ(FromUtf16({halves, 3}), "\xEF\xBF\xBDx\xEF\xBF\xBD");
    EXPECT_EQ(ToUtf16("\xFF"), u"\uFFFD");
}

}  // namespace
}  // namespace zebtell::erp::odbc
