#pragma once

#include "erp/bound_sql.h"

namespace zebtell::erp {

// The programs that this is linked into write, into the folder $ZEBTELL_TSQL when it is set, the
// statements that SQL Server would have been asked while their tests ran: one a line, in a file
// named after the program. tests/tsql checks them.

// A statement that a connection was given. Those that are not made for one database only are the
// same for SQL Server.
void RecordRun(const BoundSql& sql);

}  // namespace zebtell::erp
