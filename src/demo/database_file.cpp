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

// A prepared insert statement.
class TableRows : public RowWriter {
  public:
    TableRows(sqlite3* handle, const std::string& insert) {
        sqlite3_stmt* statement = nullptr;
        const int result = sqlite3_prepare_v2(handle, insert.c_str(), -1, &statement, nullptr);
        statement_.reset(statement);
        Check(result == SQLITE_OK, handle);
    }

    void Write(std::span<const Cell> row) override {
        int position = 0;
        for (const Cell& cell : row) {
            ++position;
            std::visit([&](const auto& value) { Bind(position, value); }, cell);
        }
        Check(sqlite3_step(statement_.get()) == SQLITE_DONE, sqlite3_db_handle(statement_.get()));
        sqlite3_reset(statement_.get());
    }

  private:
    void Bind(int position, std::monostate) { sqlite3_bind_null(statement_.get(), position); }
    void Bind(int position, std::int64_t number) {
        sqlite3_bind_int64(statement_.get(), position, number);
    }
    void Bind(int position, double number) {
        sqlite3_bind_double(statement_.get(), position, number);
    }
    void Bind(int position, base::Currency amount) { Bind(position, amount.ToDouble()); }
    void Bind(int position, base::DateTime date) {
        BindText(position, date.ToIso(), SQLITE_TRANSIENT);
    }
    void Bind(int position, std::string_view text) {  // it outlives the step that reads it
        BindText(position, text, SQLITE_STATIC);
    }
    void BindText(int position, std::string_view text, sqlite3_destructor_type keeping) {
        sqlite3_bind_text(statement_.get(), position, text.data(), int(text.size()), keeping);
    }

    struct Finalize {
        void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
    };
    std::unique_ptr<sqlite3_stmt, Finalize> statement_;
};

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

RowWriter& DatabaseFile::Table(std::string_view name,
                               const std::vector<std::string_view>& columns) {
    tables_.push_back(std::make_unique<TableRows>(handle(), InsertText(name, columns)));
    return *tables_.back();
}

void DatabaseFile::Finish() {
    tables_.clear();
    Execute(postponed_ + "analyze; commit; pragma synchronous = full; pragma journal_mode = wal");
    handle_.reset();
}

}  // namespace zebtell::demo
