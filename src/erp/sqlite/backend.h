#pragma once

#include <string>

#include "erp/connection.h"
#include "erp/sqlite/connection.h"

namespace zebtell::erp::sqlite {

// A company database in one SQLite file.
class SqliteBackend : public Backend {
  public:
    explicit SqliteBackend(std::string path, const ConnectionLimits& limits = {})
        : path_(std::move(path)), limits_(limits) {}

    std::unique_ptr<Connection> Connect(Access access) override;
    std::unique_ptr<CommitWatch> WatchCommits() override;
    Dialect dialect() const override { return Dialect::kSqlite; }

  private:
    std::string path_;
    ConnectionLimits limits_;
};

}  // namespace zebtell::erp::sqlite
