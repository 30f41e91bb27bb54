#pragma once

#include <string_view>

namespace zebtell::erp::sql {

// Whether SQL Server takes the word for a part of a statement unless it is quoted. Ignores case.
bool IsReservedOnServer(std::string_view word);

}  // namespace zebtell::erp::sql
