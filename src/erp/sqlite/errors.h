#pragma once

#include <sqlite3.h>

namespace zebtell::erp::sqlite {

// Throws the RuntimeError for the code of a failed call. Names no file; what the statement's text
// could bring into the description is HTML-escaped. `database` may be null.
[[noreturn]] void Fail(sqlite3* database, int code);

inline void Check(sqlite3* database, int code) {
    if (code != SQLITE_OK) {
        Fail(database, code);
    }
}

}  // namespace zebtell::erp::sqlite
