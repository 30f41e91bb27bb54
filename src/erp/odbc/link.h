#pragma once

#include <chrono>
#include <string>

#include "erp/odbc/api.h"
#include "erp/odbc/server_kind.h"

namespace zebtell::erp::odbc {

struct ConnectionLimits {
    std::chrono::seconds connect{5};
    std::chrono::seconds statement{10};
};

// A connection's handle with what its statements have to know.
struct Link {
    ServerKind kind;
    ConnectionLimits limits;
    SQLHDBC handle;
    bool broken = false;  // lost, or may still be busy with something
};

}  // namespace zebtell::erp::odbc
