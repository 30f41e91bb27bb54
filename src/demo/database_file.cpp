#include "demo/database_file.h"

#include "base/runtime_error.h"

namespace zebtell::demo {
namespace {

void Check(bool good, sqlite3* handle) {
    if (!good) {
        throw base::RuntimeError(base::errors::kStatementFailed, sqlite3_errmsg(handle));
    }
}

int AppendIndex(void* statements, int, char** values, char**) {
    static_cast<std::string*>(statements)->append(values[0]).append(";\n");
    return 0;
}

std::string InsertText(std::string_view table, const std::vector<std::string_view>& columns) {
    std::string names;
    std::string marks;
    for (std::string_view column : columns) {
        const std::string_view comma = names.empty() ? "" : ", ";
        names.append(comma).append(column);
        marks.append(comma).append("?");
    }
    return "insert into " + std::string(table) + " (" + names + ") values (" + marks + ")";
}

}  // namespace

DatabaseFile::DatabaseFile(const std::filesystem::path& path) {
    sqlite3* handle = nullptr;
    const int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE;
    const int result = sqlite3_open_v2(path.c_str(), &handle, flags, nullptr);
    handle_.reset(handle);
    Check(result == SQLITE_OK, handle);
    // Nobody else sees the file yet, and a failed run throws it away.
    Execute(
        "pragma journal_mode = off; pragma synchronous = off; pragma locking_mode = exclusive;"
        "pragma cache_size = -65536; pragma foreign_keys = off; begin");
}

void DatabaseFile::Execute(const std::string& sql) {
    Check(sqlite3_exec(handle(), sql.c_str(), nullptr, nullptr, nullptr) == SQLITE_OK, handle());
}

void DatabaseFile::PostponeIndexes() {
    const auto collect = [this](const char* sql) {
        std::string statements;
        const int result = sqlite3_exec(handle(), sql, AppendIndex, &statements, nullptr);
        Check(result == SQLITE_OK, handle());
        return statements;
    };
    const std::string drops = collect(
        "select 'drop index ' || name from sqlite_master where type = 'index' and sql is not null");
    postponed_ = collect("select sql from sqlite_master where type = 'index' and sql is not null");
    Execute(drops);
}

void DatabaseFile::Finish() {
    Execute(postponed_ + "analyze; commit; pragma synchronous = full; pragma journal_mode = wal");
    handle_.reset();
}

Insert::Insert(const DatabaseFile& file,
               std::string_view table,
               const std::vector<std::string_view>& columns) {
    const std::string text = InsertText(table, columns);
    sqlite3_stmt* statement = nullptr;
    const int result = sqlite3_prepare_v2(file.handle(), text.c_str(), -1, &statement, nullptr);
    statement_.reset(statement);
    Check(result == SQLITE_OK, file.handle());
}

void Insert::Bind(int position, std::int64_t number) {
    sqlite3_bind_int64(statement_.get(), position, number);
}

void Insert::Bind(int position, double number) {
    sqlite3_bind_double(statement_.get(), position, number);
}

void Insert::Bind(int position, base::Currency amount) {
    Bind(position, amount.ToDouble());
}

void Insert::Bind(int position, base::DateTime date) {
    const std::string text = date.ToIso();
    sqlite3_bind_text(statement_.get(), position, text.data(), int(text.size()), SQLITE_TRANSIENT);
}

void Insert::Bind(int position, Link link) {
    if (link.id == 0) {
        sqlite3_bind_null(statement_.get(), position);
    } else {
        Bind(position, link.id);
    }
}

void Insert::Bind(int position, std::string_view text) {
    if (text.empty()) {
        sqlite3_bind_null(statement_.get(), position);
    } else {  // the text outlives the step that reads it
        sqlite3_bind_text(statement_.get(), position, text.data(), int(text.size()), SQLITE_STATIC);
    }
}

void Insert::Run() {
    sqlite3* handle = sqlite3_db_handle(statement_.get());
    Check(sqlite3_step(statement_.get()) == SQLITE_DONE, handle);
    sqlite3_reset(statement_.get());
}

}  // namespace zebtell::demo
