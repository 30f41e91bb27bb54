#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "erp/bound_sql.h"

namespace zebtell::erp::sql {

// Statements are put together from pieces, each with the values of its own marks.

void Append(BoundSql& out, BoundSql&& piece);
// Writes a mark for the value.
void AppendValue(BoundSql& out, base::Value value);
// Puts a text before what a piece says.
void Prepend(BoundSql& piece, std::string_view text);

// "[1,2,3]"
std::string JsonList(std::span<const std::int64_t> numbers);

// Names of the schema, and those that texts give to columns; quoted unless they are plain.
void AppendName(BoundSql& out, std::string_view name, Dialect dialect);

// A text as a literal, where a mark would not do.
void AppendTextLiteral(BoundSql& out, std::string_view text, Dialect dialect);

// What stands behind a value for "is one of the numbers"; `as_text` when the value is a text, which
// SQL Server would else turn into a number.
void AppendInJson(BoundSql& out, std::string json, Dialect dialect, bool as_text);

}  // namespace zebtell::erp::sql
