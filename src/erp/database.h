#pragma once

#include <memory>
#include <string>

#include "base/clock.h"
#include "data/data_application.h"

namespace zebtell::erp {

// The company databases of a process, opened when first used and shared by all sessions:
// connection pools, schemas and lists. Thread-safe; outlives every application made from it.
class Databases {
  public:
    explicit Databases(base::Clock clock);
    ~Databases();

    std::unique_ptr<data::DataApplication> NewApplication();

    // Whether the database answers; for health checks. Never throws.
    bool IsReachable(data::DatabaseType type, const std::string& path);

  private:
    class Pools;
    std::unique_ptr<Pools> pools_;
};

}  // namespace zebtell::erp
