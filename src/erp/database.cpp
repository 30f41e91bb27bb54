#include "erp/database.h"

#include "base/ignore_errors.h"
#include "base/runtime_error.h"
#include "erp/application.h"
#include "erp/company_database.h"
#include "erp/odbc/backend.h"
#include "erp/odbc/connection_string.h"
#include "erp/sqlite/backend.h"

namespace zebtell::erp {

std::unique_ptr<Backend> MakeBackend(data::DatabaseType type, const std::string& path) {
    if (type == data::DatabaseType::kSqlite) {
        return std::make_unique<sqlite::SqliteBackend>(path);
    }
    return std::make_unique<odbc::OdbcBackend>(path);
}

DatabaseAddress AddressFor(data::DatabaseType type,
                           std::string_view path,
                           std::string_view user,
                           std::string_view password) {
    const std::string text = odbc::ConnectionString(path);
    if (type != data::DatabaseType::kSqlServer || odbc::HasLogin(text)) {
        return {type, std::string(path)};
    }
    return {type, odbc::WithLogin(text, user, password), true};
}

Databases::Databases(base::Clock clock) : Databases(std::move(clock), MakeBackend) {}

Databases::Databases(base::Clock clock, BackendFactory make_backend)
    : clock_(std::move(clock)), make_backend_(std::move(make_backend)) {}

Databases::~Databases() = default;

std::unique_ptr<data::DataApplication> Databases::NewApplication() {
    return std::make_unique<Application>(
        [this](const DatabaseAddress& address) { return Find(address); }, clock_);
}

bool Databases::IsReachable(data::DatabaseType type, const std::string& path) {
    return base::IgnoreErrors([&] {
        try {
            Find({type, path})->pool().Reading([](Connection& connection) {
                connection.Execute({"SELECT ID FROM SYUser WHERE ID = 0", {}});
                return true;
            });
        } catch (const LoginRefused&) {
            // Nobody's log-on is refused by a server that is there.
            if (!AddressFor(type, path, "", "").is_users_own) {
                throw;
            }
        }
    });
}

std::shared_ptr<CompanyDatabase> Databases::Find(const DatabaseAddress& address) {
    const auto place = PlaceOf(address);
    const auto came = std::chrono::steady_clock::now();
    std::lock_guard lock(place->mutex);
    if (auto open = place->used.lock()) {
        return open;
    }
    // A server that is not there costs each try some seconds: all who wait for one share its
    // answer.
    if (place->problem && place->tried > came) {
        std::rethrow_exception(place->problem);
    }
    try {
        auto opened = std::make_shared<CompanyDatabase>(make_backend_(address.type, address.path));
        place->used = opened;
        place->kept = address.is_users_own ? nullptr : opened;
        place->problem = nullptr;
        return opened;
    } catch (const std::exception&) {
        place->problem = std::current_exception();
        place->tried = std::chrono::steady_clock::now();
        throw;
    }
}

std::shared_ptr<Databases::Place> Databases::PlaceOf(const DatabaseAddress& address) {
    std::lock_guard lock(mutex_);
    std::erase_if(places_, [](const auto& known) {
        return known.first.is_users_own && known.second.use_count() == 1 &&
               known.second->used.expired();
    });
    auto& place = places_[address];
    if (!place) {
        place = std::make_shared<Place>();
    }
    return place;
}

}  // namespace zebtell::erp
