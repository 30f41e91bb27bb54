#pragma once

#include <filesystem>
#include <memory>

#include "erp/odbc/backend.h"

namespace zebtell::erp {

// A SQLite file as a database behind an ODBC driver. While it lives, every new SQLite connection of
// the process knows the functions that translated statements call.
class OdbcSqlite {
  public:
    explicit OdbcSqlite(const std::filesystem::path& file);
    ~OdbcSqlite();
    OdbcSqlite(const OdbcSqlite&) = delete;
    OdbcSqlite& operator=(const OdbcSqlite&) = delete;

    static bool IsInstalled();
    std::string connection_string() const;
    std::unique_ptr<Backend> MakeBackend() const;

  private:
    std::filesystem::path file_;
};

}  // namespace zebtell::erp
