#pragma once

#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <utility>

#include "base/clock.h"
#include "data/data_application.h"

namespace zebtell::erp {

class Backend;
class CompanyDatabase;

// Makes the way to a database of a kind; RuntimeError kUnspecified for a kind that is not built in.
using BackendFactory =
    std::function<std::unique_ptr<Backend>(data::DatabaseType, const std::string& path)>;

std::unique_ptr<Backend> MakeBackend(data::DatabaseType type, const std::string& path);

// The company databases of a process, opened when first used and shared by all sessions:
// connection pools, schemas and lists. Thread-safe; outlives every application made from it.
class Databases {
  public:
    explicit Databases(base::Clock clock);
    Databases(base::Clock clock, BackendFactory make_backend);
    ~Databases();

    std::unique_ptr<data::DataApplication> NewApplication();

    // Whether the database answers; for health checks. Never throws.
    bool IsReachable(data::DatabaseType type, const std::string& path);

  private:
    std::shared_ptr<CompanyDatabase> Find(data::DatabaseType type, const std::string& path);

    base::Clock clock_;
    BackendFactory make_backend_;
    std::mutex mutex_;
    std::map<std::pair<data::DatabaseType, std::string>, std::shared_ptr<CompanyDatabase>> open_;
};

}  // namespace zebtell::erp
