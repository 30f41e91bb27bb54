#pragma once

#include <chrono>
#include <compare>
#include <exception>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>

#include "base/clock.h"
#include "data/data_application.h"

namespace zebtell::erp {

class Backend;
class CompanyDatabase;

// Makes the way to a database of a kind; RuntimeError kUnspecified for a kind that is not built in.
using BackendFactory =
    std::function<std::unique_ptr<Backend>(data::DatabaseType, const std::string& path)>;

std::unique_ptr<Backend> MakeBackend(data::DatabaseType type, const std::string& path);

// Where a company database is and, for one whose users log on to the database itself, who does.
struct DatabaseAddress {
    data::DatabaseType type = data::DatabaseType::kSqlite;
    std::string path;
    bool is_users_own = false;  // the path holds a user's name and password

    friend auto operator<=>(const DatabaseAddress&, const DatabaseAddress&) = default;
};

// The settings' path as it stands when it says who logs on, as the portal's own path does; else
// with this user.
DatabaseAddress AddressFor(data::DatabaseType type,
                           std::string_view path,
                           std::string_view user,
                           std::string_view password);

// The company databases of a process, opened when first used and shared by all sessions:
// connection pools, schemas and lists. A user's own is closed with his last session. Thread-safe;
// outlives every application made from it.
class Databases {
  public:
    explicit Databases(base::Clock clock);
    Databases(base::Clock clock, BackendFactory make_backend);
    ~Databases();

    std::unique_ptr<data::DataApplication> NewApplication();

    // Whether the database answers; for health checks. Never throws.
    bool IsReachable(data::DatabaseType type, const std::string& path);

  private:
    // A database on its way to be opened, or open.
    struct Place {
        std::mutex mutex;
        std::shared_ptr<CompanyDatabase> kept;
        std::weak_ptr<CompanyDatabase> used;
        std::exception_ptr problem;
        std::chrono::steady_clock::time_point tried;
    };

    std::shared_ptr<CompanyDatabase> Find(const DatabaseAddress& address);
    std::shared_ptr<Place> PlaceOf(const DatabaseAddress& address);

    base::Clock clock_;
    BackendFactory make_backend_;
    std::mutex mutex_;
    std::map<DatabaseAddress, std::shared_ptr<Place>> places_;
};

}  // namespace zebtell::erp
