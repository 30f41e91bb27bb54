#pragma once

#include <string_view>

namespace zebtell::erp::sql {

// RuntimeError kStatementFailed: what is wrong, and the piece of text where, shortened and
// HTML-escaped.
[[noreturn]] void Fail(std::string_view what, std::string_view where = {});

// RuntimeError kNoSuchTable, alike for tables that are not there and that nobody may read.
[[noreturn]] void FailNoTable(std::string_view table);

}  // namespace zebtell::erp::sql
