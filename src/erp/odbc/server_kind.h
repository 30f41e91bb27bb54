#pragma once

#include <string>

#include "erp/bound_sql.h"

namespace zebtell::erp::odbc {

// What the adapter has to know of the kind of server behind a driver. Statements may be empty.
struct ServerKind {
    Dialect dialect = Dialect::kSqlServer;
    std::string set_up;        // run on each new connection
    std::string set_up_read;   // and on those for reading, or
    std::string set_up_write;  // for writing
    std::string begin;
    std::string commit;
    std::string rollback;  // also when there is nothing to roll back
    // What makes an insert give the new row's key: text behind it or, when that is empty, a
    // statement of its own.
    std::string insert_suffix;
    std::string last_key;
    // Columns take values of any type, as SQLite's do: amounts are bound as binary numbers, dates
    // as ISO text, and computed numbers are read as they are written.
    bool loose_types = false;
};

const ServerKind& SqlServer();

}  // namespace zebtell::erp::odbc
