#pragma once

#include <vector>

#include "erp/schema.h"

namespace zebtell::erp {

// Views have no foreign keys, nor have the tables of every company database: a column IDX without
// one is given the link that the portal knows it by, else that to the table X, else the one that
// another table's column of the same name has.
void AddLinksByName(std::vector<TableInfo>& tables);

}  // namespace zebtell::erp
