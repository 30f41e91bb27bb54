#pragma once

#include <sqlite3.h>

#include <filesystem>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "demo/company_store.h"

namespace zebtell::demo {

// A new SQLite file that is being filled: tables first, rows in one go, indexes last. Not durable
// until Finish. Database errors throw RuntimeError kStatementFailed.
class DatabaseFile : public CompanyStore {
  public:
    explicit DatabaseFile(const std::filesystem::path& path);

    void Execute(const std::string& sql);
    // Leaves the indexes of the schema out until Finish makes them, which is many times faster.
    void PostponeIndexes();
    RowWriter& Table(std::string_view name, const std::vector<std::string_view>& columns) override;
    void Finish();

  private:
    struct Close {
        void operator()(sqlite3* handle) const { sqlite3_close_v2(handle); }
    };
    sqlite3* handle() const { return handle_.get(); }

    std::unique_ptr<sqlite3, Close> handle_;
    std::vector<std::unique_ptr<RowWriter>> tables_;
    std::string postponed_;
};

}  // namespace zebtell::demo
