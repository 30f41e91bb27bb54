#pragma once

#include <memory>
#include <string>

#include "erp/connection.h"
#include "erp/odbc/connection.h"

namespace zebtell::erp::odbc {

// A company database on a server, through an ODBC driver.
class OdbcBackend : public Backend {
  public:
    // `path` is a connection string or a data source's name.
    explicit OdbcBackend(std::string_view path,
                         const ServerKind& kind = SqlServer(),
                         const ConnectionLimits& limits = {});

    std::unique_ptr<Connection> Connect(Access access) override;
    // Servers don't tell a login of few rights what others have committed, so what is cached counts
    // for a second.
    std::unique_ptr<CommitWatch> WatchCommits() override;
    Dialect dialect() const override { return kind_.dialect; }

  private:
    std::string connection_string_;
    ServerKind kind_;
    ConnectionLimits limits_;
    std::shared_ptr<Environment> environment_;
};

}  // namespace zebtell::erp::odbc
