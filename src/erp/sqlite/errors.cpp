#include "erp/sqlite/errors.h"

#include <string>
#include <string_view>

#include "base/runtime_error.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::sqlite {
namespace {

struct Meaning {
    int code;  // a primary result code
    int number;
    const char* description;
};

constexpr Meaning kMeanings[] = {
    {SQLITE_BUSY, base::errors::kUnspecified, "The database is busy"},
    {SQLITE_LOCKED, base::errors::kUnspecified, "The database is busy"},
    {SQLITE_CANTOPEN, base::errors::kUnspecified, "The company database is not there"},
    {SQLITE_NOTADB, base::errors::kUnspecified, "The company database is not a database"},
    {SQLITE_CORRUPT, base::errors::kUnspecified, "The company database is damaged"},
    {SQLITE_IOERR, base::errors::kUnspecified, "The company database can't be read or written"},
    {SQLITE_PERM, base::errors::kUnspecified, "The company database may not be read"},
    {SQLITE_AUTH, base::errors::kUnspecified, "The company database may not be read"},
    {SQLITE_FULL, base::errors::kUnspecified, "There is no room left for the company database"},
    {SQLITE_NOMEM, base::errors::kUnspecified, "Not enough memory"},
    {SQLITE_READONLY, base::errors::kStatementFailed, "The database may not be written to"},
    {SQLITE_INTERRUPT, base::errors::kStatementFailed, "The statement took too long"},
    {SQLITE_TOOBIG, base::errors::kStatementFailed, "The statement or a value is too long"},
    {SQLITE_CONSTRAINT, base::errors::kStatementFailed, "The record conflicts with another one"},
};

}  // namespace

void Fail(sqlite3* database, int code) {
    for (const Meaning& meaning : kMeanings) {
        if (meaning.code == (code & 0xFF)) {
            throw base::RuntimeError(meaning.number, meaning.description);
        }
    }
    const std::string words = database ? sqlite3_errmsg(database) : sqlite3_errstr(code);
    sql::Fail("The statement failed", words);
}

}  // namespace zebtell::erp::sqlite
