#pragma once

#include <vector>

#include "erp/schema.h"

namespace zebtell::erp {

// Views have no foreign keys: their column IDX is given the link to the table X, or, when there is
// no such table, the link that another table's column of the same name has.
void FindViewLinks(std::vector<TableInfo>& tables);

}  // namespace zebtell::erp
