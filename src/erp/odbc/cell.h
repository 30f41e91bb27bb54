#pragma once

#include <cstddef>
#include <string>

#include "base/value.h"
#include "erp/odbc/api.h"
#include "erp/odbc/column_types.h"

namespace zebtell::erp::odbc {

// How a column's values come from the driver. Decimals come as their digits, never as binary
// numbers.
enum class Wire { kInteger, kDouble, kDigits, kTime, kText };

struct ResultColumn {
    std::string name;
    ColumnType type = ColumnType::kText;
    Wire wire = Wire::kText;
    SQLULEN length = 0;  // characters; 0: no limit
    bool padded = false;

    SQLSMALLINT CType() const;
    std::size_t Bytes() const;  // that a value takes at the most; 0: no limit

    friend bool operator==(const ResultColumn&, const ResultColumn&) = default;
};

ResultColumn MakeResultColumn(std::string name, const DescribedColumn& described, bool loose_types);

// The value of `length` bytes as the driver has written them, null for SQL_NULL_DATA.
base::Value ReadCell(const ResultColumn& column, const std::byte* data, SQLLEN length);
// The same of a number; null: 0.
std::int64_t ReadInteger(const ResultColumn& column, const std::byte* data, SQLLEN length);

}  // namespace zebtell::erp::odbc
