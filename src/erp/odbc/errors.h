#pragma once

#include "erp/odbc/api.h"
#include "erp/odbc/link.h"

namespace zebtell::erp::odbc {

inline bool Succeeded(SQLRETURN code) {
    return code == SQL_SUCCESS || code == SQL_SUCCESS_WITH_INFO;
}

// Throws what the handle's diagnostics mean, and marks the link as broken where they say so.
[[noreturn]] void Fail(Link& link, SQLSMALLINT type, SQLHANDLE handle);
// The same of an attempt to connect.
[[noreturn]] void FailToConnect(SQLHDBC handle);

// For calls on statements.
inline void Check(Link& link, SQLHSTMT statement, SQLRETURN code) {
    if (!Succeeded(code) && code != SQL_NO_DATA) {
        Fail(link, SQL_HANDLE_STMT, statement);
    }
}

}  // namespace zebtell::erp::odbc
