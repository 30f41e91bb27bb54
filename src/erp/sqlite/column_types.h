#pragma once

#include <sqlite3.h>

#include <optional>
#include <string_view>

#include "base/value.h"
#include "erp/schema.h"

namespace zebtell::erp::sqlite {

// What a declared type ("NVARCHAR(40)", "MONEY") stands for; nothing for no type at all, as
// expressions have.
std::optional<ColumnType> TypeOf(std::string_view declared);

// The n of "NVARCHAR(n)", 0 for types without one.
int LengthOf(std::string_view declared);

// The value of the row that was stepped to, as its declared type says; without one, as it is
// stored.
base::Value ReadColumn(sqlite3_stmt* statement, int column, std::optional<ColumnType> type);

// Binds a value to a parameter (from 1). Returns SQLite's result code.
int BindValue(sqlite3_stmt* statement, int parameter, const base::Value& value);

}  // namespace zebtell::erp::sqlite
