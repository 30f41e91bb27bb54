#pragma once

#include <memory>
#include <string>

#include "erp/connection.h"
#include "erp/odbc/statement.h"
#include "erp/statement_cache.h"

namespace zebtell::erp::odbc {

// The ODBC library as one database uses it; shared by its connections.
using Environment = Handle<SQL_HANDLE_ENV>;

// A connection's handle, disconnected before it is freed.
class ConnectionHandle {
  public:
    ConnectionHandle(const Environment& environment,
                     const std::string& connection_string,
                     std::chrono::seconds limit);
    ~ConnectionHandle() { SQLDisconnect(handle_.get()); }
    ConnectionHandle(const ConnectionHandle&) = delete;
    ConnectionHandle& operator=(const ConnectionHandle&) = delete;

    SQLHDBC get() const { return handle_.get(); }

  private:
    Handle<SQL_HANDLE_DBC> handle_;
};

class OdbcConnection : public Connection {
  public:
    // RuntimeError kLogonFailed when the server refuses the log-on, kUnspecified when it does not
    // answer within the limit.
    OdbcConnection(std::shared_ptr<Environment> environment,
                   const std::string& connection_string,
                   const ServerKind& kind,
                   Access access,
                   const ConnectionLimits& limits);

    std::unique_ptr<Cursor> Query(const BoundSql& sql) override;
    void Execute(const BoundSql& sql) override;
    std::int64_t Insert(const BoundSql& sql) override;
    void Begin() override;
    void Commit() override;
    void Rollback() noexcept override;
    bool IsBroken() const override { return link_.broken; }
    bool Answers() override;
    DatabaseDescription Describe() override;

  private:
    class OpenCursor;

    void RefuseSecondResult() const;
    void Run(const std::string& text);
    std::int64_t ReadKey(const BoundSql& sql);

    std::shared_ptr<Environment> environment_;
    ConnectionHandle handle_;
    Link link_;
    bool reading_ = false;  // a cursor is open
    StatementCache<Statement> statements_;
};

}  // namespace zebtell::erp::odbc
