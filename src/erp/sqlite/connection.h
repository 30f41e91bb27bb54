#pragma once

#include <sqlite3.h>

#include <chrono>
#include <memory>
#include <string>

#include "erp/connection.h"
#include "erp/sqlite/statement.h"
#include "erp/statement_cache.h"

namespace zebtell::erp::sqlite {

struct ConnectionLimits {
    std::chrono::milliseconds busy{5000};      // the wait for somebody else's write
    std::chrono::milliseconds reading{10000};  // the longest that a reading statement may take
};

// A connection to a database file that exists; a missing one is not made.
class SqliteConnection : public Connection {
  public:
    SqliteConnection(const std::string& path, Access access, const ConnectionLimits& limits);
    ~SqliteConnection() override;
    SqliteConnection(const SqliteConnection&) = delete;
    SqliteConnection& operator=(const SqliteConnection&) = delete;

    std::unique_ptr<Cursor> Query(const BoundSql& sql) override;
    void Execute(const BoundSql& sql) override;
    std::int64_t Insert(const BoundSql& sql) override;
    void Begin() override;
    void Commit() override;
    void Rollback() noexcept override;
    DatabaseDescription Describe() override;

    // Another number whenever other connections have committed something.
    std::int64_t DataVersion();

  private:
    class OpenCursor;

    void SetUp(Access access);
    void Run(const char* text);
    static int OutOfTime(void* connection);

    ConnectionLimits limits_;
    sqlite3* database_ = nullptr;
    std::unique_ptr<StatementCache<Statement>> statements_;
    std::chrono::steady_clock::time_point deadline_;
};

}  // namespace zebtell::erp::sqlite
