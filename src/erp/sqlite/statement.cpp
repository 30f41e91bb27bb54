#include "erp/sqlite/statement.h"

#include "base/runtime_error.h"
#include "erp/sqlite/column_types.h"
#include "erp/sqlite/errors.h"

namespace zebtell::erp::sqlite {

Statement::Statement(sqlite3* database, const std::string& text) : database_(database) {
    const char* rest = nullptr;
    const int code = sqlite3_prepare_v3(database,
                                        text.data(),
                                        static_cast<int>(text.size()),
                                        SQLITE_PREPARE_PERSISTENT,
                                        &handle_,
                                        &rest);
    Check(database, code);
    const std::size_t read = static_cast<std::size_t>(rest - text.data());
    if (!handle_ || text.find_first_not_of(" \t\r\n;", read) != std::string::npos) {
        sqlite3_finalize(handle_);
        throw base::RuntimeError(base::errors::kStatementFailed, "Not one statement");
    }
    ReadColumns();
}

Statement::~Statement() {
    sqlite3_finalize(handle_);
}

void Statement::ReadColumns() {
    const int count = sqlite3_column_count(handle_);
    for (int column = 0; column < count; ++column) {
        const char* name = sqlite3_column_name(handle_, column);
        const char* declared = sqlite3_column_decltype(handle_, column);
        columns_.emplace_back(name ? name : "");
        types_.push_back(TypeOf(declared ? declared : ""));
    }
}

void Statement::Bind(const std::vector<base::Value>& values) {
    int parameter = 0;
    for (const base::Value& value : values) {
        Check(database_, BindValue(handle_, ++parameter, value));
    }
}

void Statement::Reset() {
    sqlite3_reset(handle_);
    sqlite3_clear_bindings(handle_);
}

bool Statement::Step() {
    const int code = sqlite3_step(handle_);
    if (code == SQLITE_ROW) {
        return true;
    }
    if (code != SQLITE_DONE) {
        Fail(database_, code);
    }
    return false;
}

}  // namespace zebtell::erp::sqlite
