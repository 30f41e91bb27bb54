#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <memory>
#include <mutex>
#include <vector>

#include "erp/connection.h"

namespace zebtell::erp {

class ConnectionPool;

// A connection lent by a pool for the duration of one call.
class Lease {
  public:
    Lease(ConnectionPool& pool, Access access, std::unique_ptr<Connection> connection)
        : pool_(&pool), access_(access), connection_(std::move(connection)) {}
    Lease(Lease&&) = default;
    Lease& operator=(Lease&&) = delete;
    ~Lease();

    Connection& operator*() const { return *connection_; }
    Connection* operator->() const { return connection_.get(); }
    // The connection is in doubt (a commit that failed): it is closed instead of lent again.
    void Drop() { dropped_ = true; }

  private:
    ConnectionPool* pool_;
    Access access_;
    std::unique_ptr<Connection> connection_;
    bool dropped_ = false;
};

// The connections of one database: as many for reading as threads read at the same time, the one
// used last first, since it is the warmest; one for writing. Thread-safe.
class ConnectionPool {
  public:
    explicit ConnectionPool(Backend& backend) : backend_(backend) {}

    Lease Read();
    // Waits for the writer before this one; RuntimeError kUnspecified "The database is busy" when
    // that takes too long.
    Lease Write();

    // Grows whenever something has been committed: at once for what a Lease of this pool has
    // written, within a millisecond for what others have.
    std::int64_t DataVersion();

  private:
    friend class Lease;
    void Return(Access access, std::unique_ptr<Connection> connection);

    Backend& backend_;
    std::mutex mutex_;
    std::condition_variable writer_back_;
    std::vector<std::unique_ptr<Connection>> readers_;
    std::unique_ptr<Connection> writer_;
    bool writing_ = false;

    // One connection that only looks: its numbers compare with one another.
    std::mutex watch_mutex_;
    std::unique_ptr<Connection> watcher_;
    std::int64_t watched_ = 0;
    std::atomic<std::int64_t> version_ = 0;
    std::atomic<std::chrono::steady_clock::time_point> looked_{};
    // How often the writer came back, now and at the last look.
    std::atomic<std::int64_t> writes_ = 0;
    std::atomic<std::int64_t> looked_writes_ = 0;
};

}  // namespace zebtell::erp
