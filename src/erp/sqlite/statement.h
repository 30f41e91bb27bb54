#pragma once

#include <sqlite3.h>

#include <list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
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

// The statements of one connection, kept for their next use; those unused longest go first.
class StatementCache {
  public:
    explicit StatementCache(sqlite3* database) : database_(database) {}

    // Takes the statement out, so that a nested use of the same text makes another one.
    std::unique_ptr<Statement> Take(const std::string& text);
    void Give(const std::string& text, std::unique_ptr<Statement> statement);
    void Clear();

  private:
    struct Kept {
        std::string text;
        std::unique_ptr<Statement> statement;
    };

    sqlite3* database_;
    std::list<Kept> kept_;  // the one used last first
    std::unordered_map<std::string_view, std::list<Kept>::iterator> by_text_;
};

}  // namespace zebtell::erp::sqlite
