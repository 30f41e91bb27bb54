#include "erp/odbc/column_types.h"

#include <algorithm>
#include <array>

#include "base/currency.h"
#include "base/text.h"

namespace zebtell::erp::odbc {
namespace {

constexpr SQLULEN kLongestText = 4000;

// Names go before type codes, since a driver gives "money" the code of any decimal.
struct NamedType {
    std::string_view name;
    ColumnType type;
};
constexpr NamedType kNamedTypes[] = {
    {"money", ColumnType::kCurrency},
    {"smallmoney", ColumnType::kCurrency},
    {"bit", ColumnType::kBoolean},
    {"bool", ColumnType::kBoolean},
    {"real", ColumnType::kDouble},
    {"float", ColumnType::kDouble},
};

struct CodedType {
    SQLSMALLINT code;
    ColumnType type;
};
constexpr CodedType kCodedTypes[] = {
    {SQL_BIT, ColumnType::kBoolean},
    {SQL_TINYINT, ColumnType::kInteger},
    {SQL_SMALLINT, ColumnType::kInteger},
    {SQL_INTEGER, ColumnType::kInteger},
    {SQL_BIGINT, ColumnType::kInteger},
    {SQL_REAL, ColumnType::kDouble},
    {SQL_FLOAT, ColumnType::kDouble},
    {SQL_DOUBLE, ColumnType::kDouble},
    {SQL_TYPE_DATE, ColumnType::kDateTime},
    {SQL_TYPE_TIMESTAMP, ColumnType::kDateTime},
    {SQL_DATE, ColumnType::kDateTime},
    {SQL_TIMESTAMP, ColumnType::kDateTime},
};

constexpr SQLSMALLINT kVariant = -150;
constexpr SQLSMALLINT kServerType = -151;
constexpr std::array kHiddenTypes = {static_cast<SQLSMALLINT>(SQL_BINARY),
                                     static_cast<SQLSMALLINT>(SQL_VARBINARY),
                                     static_cast<SQLSMALLINT>(SQL_LONGVARBINARY),
                                     kVariant,
                                     kServerType};

// Keys of an ERP are often numeric(18,0); a decimal of up to four places is an amount.
ColumnType DecimalType(const DescribedColumn& column) {
    if (column.scale == 0) {
        return ColumnType::kInteger;
    }
    const bool amount = column.sql_type == SQL_DECIMAL && column.scale <= base::Currency::kDecimals;
    return amount ? ColumnType::kCurrency : ColumnType::kDouble;
}

}  // namespace

ColumnType TypeOf(const DescribedColumn& column) {
    const std::string_view name =
        std::string_view(column.type_name).substr(0, column.type_name.find_first_of(" ("));
    for (const NamedType& known : kNamedTypes) {
        if (base::EqualNoCase(known.name, name)) {
            return known.type;
        }
    }
    if (IsDecimal(column)) {
        return DecimalType(column);
    }
    for (const CodedType& known : kCodedTypes) {
        if (known.code == column.sql_type) {
            return known.type;
        }
    }
    return ColumnType::kText;
}

bool IsShown(const DescribedColumn& column) {
    return std::find(kHiddenTypes.begin(), kHiddenTypes.end(), column.sql_type) ==
           kHiddenTypes.end();
}

SQLULEN LengthOf(const DescribedColumn& column) {
    return column.size > kLongestText ? 0 : column.size;
}

bool IsLong(const DescribedColumn& column) {
    return column.sql_type == SQL_LONGVARCHAR || column.sql_type == SQL_WLONGVARCHAR ||
           LengthOf(column) == 0;
}

}  // namespace zebtell::erp::odbc
