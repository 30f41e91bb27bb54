#pragma once

#include <vector>

#include "check/finding.h"
#include "erp/schema.h"

namespace zebtell::check {

// What the portal needs and the database does not have: tables, columns, and the foreign keys by
// which links are followed.
std::vector<Finding> MissingInDatabase(const erp::Schema& schema);

}  // namespace zebtell::check
