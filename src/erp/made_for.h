#pragma once

#include <functional>

#include "erp/bound_sql.h"

namespace zebtell::erp {

// For tests, which have no SQL Server: whatever is made for another database is made for SQL Server
// too and handed to the watcher. Set while no other thread makes statements.
using ServerSqlWatcher = std::function<void(const BoundSql& made, const BoundSql& for_server)>;
void WatchServerSql(ServerSqlWatcher watcher);

// Null when nobody watches.
const ServerSqlWatcher& WatcherOfServerSql();

// A statement that each kind of database takes in its own words: make(Dialect) gives it.
template <class Make>
BoundSql MadeFor(Dialect dialect, const Make& make) {
    BoundSql made = make(dialect);
    if (WatcherOfServerSql() && dialect != Dialect::kSqlServer) {
        WatcherOfServerSql()(made, make(Dialect::kSqlServer));
    }
    return made;
}

}  // namespace zebtell::erp
