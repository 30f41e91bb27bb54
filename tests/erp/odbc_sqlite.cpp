#include "tests/erp/odbc_sqlite.h"

#include <sqlite3.h>

#include <clocale>

#include "erp/sqlite/backend.h"
#include "erp/sqlite/functions.h"

namespace zebtell::erp {
namespace {

int Register(sqlite3* database, const char**, const void*) {
    sqlite::RegisterFunctions(database);
    return SQLITE_OK;
}

const auto kRegister = reinterpret_cast<void (*)()>(Register);

const odbc::ServerKind kKind{.dialect = Dialect::kSqlite,
                             .set_up = "",
                             .set_up_read = "PRAGMA query_only = ON",
                             .set_up_write = "",
                             .begin = "BEGIN IMMEDIATE",
                             .commit = "COMMIT",
                             .rollback = "ROLLBACK",
                             .insert_suffix = "",
                             .last_key = "SELECT last_insert_rowid()",
                             .loose_types = true};

// The file itself tells at once what others have committed.
class SqliteFileBackend : public odbc::OdbcBackend {
  public:
    SqliteFileBackend(const std::string& connection_string, const std::string& file)
        : OdbcBackend(connection_string, kKind), file_(file) {}

    std::unique_ptr<CommitWatch> WatchCommits() override { return file_.WatchCommits(); }

  private:
    sqlite::SqliteBackend file_;
};

}  // namespace

OdbcSqlite::OdbcSqlite(const std::filesystem::path& file) : file_(file) {
    // The driver takes statements in the locale's encoding.
    std::setlocale(LC_CTYPE, "C.UTF-8");
    sqlite3_auto_extension(kRegister);
}

OdbcSqlite::~OdbcSqlite() {
    sqlite3_cancel_auto_extension(kRegister);
}

bool OdbcSqlite::IsInstalled() {
    return std::filesystem::exists(ZEBTELL_SQLITE_ODBC);
}

std::string OdbcSqlite::connection_string() const {
    return std::string("Driver=") + ZEBTELL_SQLITE_ODBC + ";Database=" + file_.string() +
           ";BigInt=1;Timeout=100;FKSupport=1";
}

std::unique_ptr<Backend> OdbcSqlite::MakeBackend() const {
    return std::make_unique<SqliteFileBackend>(connection_string(), file_.string());
}

}  // namespace zebtell::erp
