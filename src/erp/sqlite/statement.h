#pragma once

#include <sqlite3.h>

#include <optional>
#include <string>
#include <vector>

#include "erp/connection.h"

namespace zebtell::erp::sqlite {

// A prepared statement with what its result's columns are.
class Statement {
  public:
    Statement(sqlite3* database, const std::string& text);
    ~Statement();
    Statement(const Statement&) = delete;
    Statement& operator=(const Statement&) = delete;

    void Bind(const std::vector<base::Value>& values);
    void Reset();
    bool Step();  // whether there is a row

    sqlite3_stmt* handle() const { return handle_; }
    const std::vector<std::string>& columns() const { return columns_; }
    std::optional<ColumnType> type(std::size_t column) const { return types_[column]; }

  private:
    void ReadColumns();

    sqlite3* database_;
    sqlite3_stmt* handle_ = nullptr;
    std::vector<std::string> columns_;
    std::vector<std::optional<ColumnType>> types_;
};

}  // namespace zebtell::erp::sqlite
