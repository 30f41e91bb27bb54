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

struct PoolLimits {
    std::size_t readers = 32;                // connections for reading at the same time
    std::chrono::milliseconds wait{10'000};  // for a connection that somebody else has
    // A connection unused for longer is asked for a sign of life before it is lent,
    std::chrono::milliseconds trusted{5'000};
    // and closed.
    std::chrono::milliseconds kept{300'000};
};

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
// used last first, since it is the warmest; one for writing. Broken ones are replaced. Thread-safe.
class ConnectionPool {
  public:
    explicit ConnectionPool(Backend& backend, const PoolLimits& limits = {})
        : backend_(backend), limits_(limits) {}

    // Both wait for others; RuntimeError kUnspecified "The database is busy" when that takes too
    // long.
    Lease Read();
    Lease Write();

    // The result of `read`(Connection&), which is called once more, with a new connection, when the
    // first one was lost on the way.
    template <class Work>
    auto Reading(const Work& read) {
        try {
            const Lease connection = Read();
            return read(*connection);
        } catch (const TransientError&) {
            CloseIdle();  // what has ended one connection has mostly ended all
        }
        const Lease connection = Read();
        return read(*connection);
    }

    // Makes a new connection, which shows whether the database still takes the log-on.
    void Renew();

    // Grows whenever something has been committed: at once for what a Lease of this pool has
    // written, soon for what others have (SQLite: within a millisecond).
    std::int64_t DataVersion();

  private:
    friend class Lease;
    using Time = std::chrono::steady_clock::time_point;

    struct Idle {
        std::unique_ptr<Connection> connection;
        Time since;
    };

    // The idle connection, or a new one when it is not there or does not answer any more.
    std::unique_ptr<Connection> Ready(Access access, Idle idle);
    Idle TakeReader();
    Idle TakeWriter();
    void Return(Access access, std::unique_ptr<Connection> connection);
    void CloseIdle();

    Backend& backend_;
    const PoolLimits limits_;
    std::mutex mutex_;
    std::condition_variable reader_back_;
    std::condition_variable writer_back_;
    std::vector<Idle> readers_;  // the one used last at the end
    std::size_t reading_ = 0;
    Idle writer_;
    bool writing_ = false;

    std::mutex watch_mutex_;
    std::unique_ptr<CommitWatch> watch_;
    std::int64_t watched_ = 0;
    std::atomic<std::int64_t> version_ = 0;
    std::atomic<Time> looked_{};
    // How often the writer came back, now and at the last look.
    std::atomic<std::int64_t> writes_ = 0;
    std::atomic<std::int64_t> looked_writes_ = 0;
};

}  // namespace zebtell::erp
