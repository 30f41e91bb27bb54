#pragma once

#include <string>

#include "erp/odbc/api.h"
#include "erp/schema.h"

namespace zebtell::erp::odbc {

// A column as a driver describes it.
struct DescribedColumn {
    std::string type_name;  // "money", "int identity"
    SQLSMALLINT sql_type = SQL_UNKNOWN_TYPE;
    SQLULEN size = 0;  // characters of texts, digits of numbers
    SQLSMALLINT scale = 0;
};

ColumnType TypeOf(const DescribedColumn& column);

// Whether it holds something that a page can show: pictures and other binary values are not.
bool IsShown(const DescribedColumn& column);

// The most characters of a text column, 0 when there is no limit that is worth knowing.
SQLULEN LengthOf(const DescribedColumn& column);
// Whether its values may be too long to make room for before they are read.
bool IsLong(const DescribedColumn& column);

// Filled up with blanks to its length.
inline bool IsPadded(const DescribedColumn& column) {
    return column.sql_type == SQL_CHAR || column.sql_type == SQL_WCHAR;
}

// Numbers that drivers give as exact decimal digits.
inline bool IsDecimal(const DescribedColumn& column) {
    return column.sql_type == SQL_DECIMAL || column.sql_type == SQL_NUMERIC;
}

}  // namespace zebtell::erp::odbc
