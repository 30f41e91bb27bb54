#pragma once

#include <vector>

#include "check/finding.h"
#include "erp/schema.h"

namespace zebtell::check {

// The tables and columns that the portal needs and the database does not have.
std::vector<Finding> MissingInDatabase(const erp::Schema& schema);

}  // namespace zebtell::check
