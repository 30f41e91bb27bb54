#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <filesystem>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "base/currency.h"
#include "base/date_time.h"

namespace zebtell::demo {

// A new SQLite file that is being filled: tables first, rows in one go, indexes last. Not durable
// until Finish. Database errors throw RuntimeError kStatementFailed.
class DatabaseFile {
  public:
    explicit DatabaseFile(const std::filesystem::path& path);

    void Execute(const std::string& sql);
    // Leaves the indexes of the schema out until Finish makes them, which is many times faster.
    void PostponeIndexes();
    void Finish();

    sqlite3* handle() const { return handle_.get(); }

  private:
    struct Close {
        void operator()(sqlite3* handle) const { sqlite3_close_v2(handle); }
    };
    std::unique_ptr<sqlite3, Close> handle_;
    std::string postponed_;
};

// A link column: 0 is stored as null.
struct Link {
    std::int64_t id = 0;
};

// An insert statement of one table, prepared once.
class Insert {
  public:
    Insert(const DatabaseFile& file,
           std::string_view table,
           const std::vector<std::string_view>& columns);

    // One row; the values are given in the order of the columns.
    template <class... Values>
    void Row(const Values&... values) {
        int position = 0;
        (Bind(++position, values), ...);
        Run();
    }

  private:
    void Bind(int position, std::int64_t number);
    void Bind(int position, int number) { Bind(position, std::int64_t{number}); }
    void Bind(int position, double number);
    void Bind(int position, base::Currency amount);
    void Bind(int position, base::DateTime date);
    void Bind(int position, Link link);
    void Bind(int position, std::string_view text);  // "" is stored as null
    void Run();

    struct Finalize {
        void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
    };
    std::unique_ptr<sqlite3_stmt, Finalize> statement_;
};

}  // namespace zebtell::demo
