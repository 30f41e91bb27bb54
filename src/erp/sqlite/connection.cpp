#include "erp/sqlite/connection.h"

#include "erp/sqlite/catalogue.h"
#include "erp/sqlite/column_types.h"
#include "erp/sqlite/errors.h"
#include "erp/sqlite/functions.h"

namespace zebtell::erp::sqlite {
namespace {

constexpr int kStepsBetweenLooks = 2000;  // some 50 us of a statement's work
// Room for the articles and price lines that every search walks through.
constexpr const char* kReadingCache = "PRAGMA cache_size = -32000";

}  // namespace

class SqliteConnection::OpenCursor : public Cursor {
  public:
    OpenCursor(StatementCache<Statement>& cache, const BoundSql& sql)
        : cache_(cache), text_(sql.text), statement_(cache.Take(text_)) {
        statement_->Bind(sql.values);
    }
    ~OpenCursor() override { cache_.Give(text_, std::move(statement_)); }
    OpenCursor(const OpenCursor&) = delete;
    OpenCursor& operator=(const OpenCursor&) = delete;

    const std::vector<std::string>& Columns() const override { return statement_->columns(); }
    bool Next() override { return statement_->Step(); }
    base::Value Get(std::size_t column) const override {
        return ReadColumn(statement_->handle(), static_cast<int>(column), statement_->type(column));
    }
    std::int64_t GetInteger(std::size_t column) const override {
        return sqlite3_column_int64(statement_->handle(), static_cast<int>(column));
    }

  private:
    StatementCache<Statement>& cache_;
    std::string text_;
    std::unique_ptr<Statement> statement_;
};

SqliteConnection::SqliteConnection(const std::string& path,
                                   Access access,
                                   const ConnectionLimits& limits)
    : limits_(limits) {
    constexpr int kFlags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX | SQLITE_OPEN_EXRESCODE;
    try {
        Check(nullptr, sqlite3_open_v2(path.c_str(), &database_, kFlags, nullptr));
        statements_ = std::make_unique<StatementCache<Statement>>([this](const std::string& text) {
            return std::make_unique<Statement>(database_, text);
        });
        SetUp(access);
    } catch (...) {
        statements_.reset();
        sqlite3_close(database_);
        throw;
    }
}

SqliteConnection::~SqliteConnection() {
    statements_.reset();
    sqlite3_close(database_);
}

void SqliteConnection::SetUp(Access access) {
    sqlite3_busy_timeout(database_, static_cast<int>(limits_.busy.count()));
    sqlite3_limit(database_, SQLITE_LIMIT_ATTACHED, 0);
    sqlite3_db_config(database_, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(database_, SQLITE_DBCONFIG_DQS_DML, 0, nullptr);
    sqlite3_db_config(database_, SQLITE_DBCONFIG_DQS_DDL, 0, nullptr);
    RegisterFunctions(database_);
    Run("PRAGMA journal_mode = WAL");
    Run("PRAGMA synchronous = FULL");
    Run("PRAGMA foreign_keys = ON");
    Run("PRAGMA temp_store = MEMORY");
    if (access == Access::kRead) {
        Run("PRAGMA query_only = ON");
        Run(kReadingCache);
        sqlite3_progress_handler(database_, kStepsBetweenLooks, OutOfTime, this);
    }
}

int SqliteConnection::OutOfTime(void* connection) {
    const auto* self = static_cast<const SqliteConnection*>(connection);
    return std::chrono::steady_clock::now() > self->deadline_ ? 1 : 0;
}

void SqliteConnection::Run(const char* text) {
    deadline_ = std::chrono::steady_clock::now() + limits_.reading;
    Check(database_, sqlite3_exec(database_, text, nullptr, nullptr, nullptr));
}

std::unique_ptr<Cursor> SqliteConnection::Query(const BoundSql& sql) {
    deadline_ = std::chrono::steady_clock::now() + limits_.reading;
    return std::make_unique<OpenCursor>(*statements_, sql);
}

void SqliteConnection::Execute(const BoundSql& sql) {
    const auto cursor = Query(sql);
    while (cursor->Next()) {
    }
}

std::int64_t SqliteConnection::Insert(const BoundSql& sql) {
    Execute(sql);
    return sqlite3_last_insert_rowid(database_);
}

void SqliteConnection::Begin() {
    Run("BEGIN IMMEDIATE");
}

void SqliteConnection::Commit() {
    Run("COMMIT");
}

void SqliteConnection::Rollback() noexcept {
    if (!sqlite3_get_autocommit(database_)) {
        sqlite3_exec(database_, "ROLLBACK", nullptr, nullptr, nullptr);
    }
}

DatabaseDescription SqliteConnection::Describe() {
    return ReadCatalogue(*this);
}

std::int64_t SqliteConnection::DataVersion() {
    static const BoundSql kVersion{"PRAGMA data_version", {}};
    const auto cursor = Query(kVersion);
    return cursor->Next() ? cursor->GetInteger(0) : 0;
}

}  // namespace zebtell::erp::sqlite
