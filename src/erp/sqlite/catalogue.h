#pragma once

#include "erp/connection.h"

namespace zebtell::erp::sqlite {

// All tables and views of a file.
DatabaseDescription ReadCatalogue(Connection& connection);

}  // namespace zebtell::erp::sqlite
