#pragma once

#include "erp/connection.h"
#include "erp/odbc/link.h"

namespace zebtell::erp::odbc {

// The tables that the portal may read, as the driver's catalogue functions describe them. They
// need no rights beyond those on the tables.
DatabaseDescription ReadCatalogue(Link& link);

}  // namespace zebtell::erp::odbc
