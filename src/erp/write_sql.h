#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/value.h"
#include "erp/bound_sql.h"

namespace zebtell::erp {

// Columns with their new values; empty texts are stored as null.
using ColumnValues = std::vector<std::pair<std::string, base::Value>>;

BoundSql InsertSql(std::string_view table, const ColumnValues& values);
BoundSql UpdateSql(std::string_view table, std::int64_t id, const ColumnValues& values);

// Stands behind a table's name in a select of a transaction: the rows that it finds, and that there
// are no others, stay so until the transaction ends; whoever else reads them so waits.
std::string_view KeptUntilCommit(Dialect dialect);

}  // namespace zebtell::erp
