#include "erp/made_for.h"

#include <utility>

namespace zebtell::erp {
namespace {

ServerSqlWatcher& Watcher() {
    static ServerSqlWatcher watcher;
    return watcher;
}

}  // namespace

void WatchServerSql(ServerSqlWatcher watcher) {
    Watcher() = std::move(watcher);
}

const ServerSqlWatcher& WatcherOfServerSql() {
    return Watcher();
}

}  // namespace zebtell::erp
