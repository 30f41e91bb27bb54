#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <filesystem>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

namespace zebtell::demo {

// A database that a test looks into.
class Sql {
  public:
    using Row = std::vector<std::string>;  // null is ""

    explicit Sql(const std::filesystem::path& file) {
        sqlite3* handle = nullptr;
        const int result = sqlite3_open_v2(file.c_str(), &handle, SQLITE_OPEN_READWRITE, nullptr);
        handle_.reset(handle);
        if (result != SQLITE_OK) throw std::runtime_error(sqlite3_errmsg(handle));
    }

    std::vector<Row> Rows(const std::string& sql) const {
        std::vector<Row> rows;
        const int result = sqlite3_exec(handle_.get(), sql.c_str(), AppendRow, &rows, nullptr);
        if (result != SQLITE_OK) throw std::runtime_error(sqlite3_errmsg(handle_.get()));
        return rows;
    }
    std::string Text(const std::string& sql) const { return Rows(sql).at(0).at(0); }
    std::int64_t Number(const std::string& sql) const { return std::stoll(Text(sql)); }

  private:
    static int AppendRow(void* rows, int count, char** values, char**) {
        Row row;
        for (int i = 0; i < count; ++i) {
            row.emplace_back(values[i] == nullptr ? "" : values[i]);
        }
        static_cast<std::vector<Row>*>(rows)->push_back(std::move(row));
        return 0;
    }
    struct Close {
        void operator()(sqlite3* handle) const { sqlite3_close_v2(handle); }
    };
    std::unique_ptr<sqlite3, Close> handle_;
};

}  // namespace zebtell::demo
