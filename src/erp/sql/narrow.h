#pragma once

#include "erp/sql/ast.h"

namespace zebtell::erp::sql {

// Gives joined subqueries the lists that their join limits them to anyway: of
//   ... from A left join (select x.k, ... from x ...) D on A.c = D.k where A.c in (1, 2)
// the subquery is read for 1 and 2 only. The databases would read it as a whole first, which for
// the prices of one page is those of all articles.
void NarrowSubqueries(Select& select);

}  // namespace zebtell::erp::sql
