#pragma once

#include "erp/access.h"
#include "erp/sql/ast.h"

namespace zebtell::erp::sql {

// The condition on a table's rows for a role, null when there is none. Parsed once per process.
const Expr* RowScope(const AccessRule& rule, Role role);

// A value of the reader by its name in the policy: a number, or a list as JSON.
struct ReaderValue {
    base::Value value;
    bool is_list;
};
ReaderValue ValueOf(const Reader& reader, std::string_view name);

}  // namespace zebtell::erp::sql
