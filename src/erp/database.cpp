#include "erp/database.h"

#include "base/ignore_errors.h"
#include "base/runtime_error.h"
#include "erp/application.h"
#include "erp/company_database.h"
#include "erp/odbc/backend.h"
#include "erp/sqlite/backend.h"

namespace zebtell::erp {

std::unique_ptr<Backend> MakeBackend(data::DatabaseType type, const std::string& path) {
    if (type == data::DatabaseType::kSqlite) {
        return std::make_unique<sqlite::SqliteBackend>(path);
    }
    return std::make_unique<odbc::OdbcBackend>(path);
}

Databases::Databases(base::Clock clock) : Databases(std::move(clock), MakeBackend) {}

Databases::Databases(base::Clock clock, BackendFactory make_backend)
    : clock_(std::move(clock)), make_backend_(std::move(make_backend)) {}

Databases::~Databases() = default;

std::unique_ptr<data::DataApplication> Databases::NewApplication() {
    return std::make_unique<Application>(
        [this](data::DatabaseType type, const std::string& path) { return Find(type, path); },
        clock_);
}

bool Databases::IsReachable(data::DatabaseType type, const std::string& path) {
    return base::IgnoreErrors([&] {
        const auto database = Find(type, path);
        database->pool().Read()->Execute({"SELECT ID FROM SYUser WHERE ID = 0", {}});
    });
}

std::shared_ptr<CompanyDatabase> Databases::Find(data::DatabaseType type, const std::string& path) {
    std::lock_guard lock(mutex_);
    auto& database = open_[{type, path}];
    if (!database) {
        database = std::make_shared<CompanyDatabase>(make_backend_(type, path));
    }
    return database;
}

}  // namespace zebtell::erp
