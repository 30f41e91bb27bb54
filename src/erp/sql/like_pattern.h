#pragma once

#include <string>
#include <string_view>

#include "erp/bound_sql.h"
#include "erp/sql/lexer.h"

namespace zebtell::erp::sql {

// A pattern as the database takes it, with "\" as its escape: in filters "*" and "?" are wildcards
// and "%" and "_" mean themselves, in statements "%" and "_" are the wildcards.
std::string LikePattern(std::string_view pattern, Style style, Dialect dialect);

}  // namespace zebtell::erp::sql
