#include "erp/connection_pool.h"

#include "base/runtime_error.h"

namespace zebtell::erp {
namespace {

constexpr std::chrono::seconds kWriterWait{10};
constexpr std::size_t kIdleReaders = 32;
// A look takes some 5 us; thousands of pages a second share it.
constexpr std::chrono::milliseconds kLookTime{1};

}  // namespace

Lease::~Lease() {
    if (!connection_) {
        return;  // moved away
    }
    if (dropped_) {
        connection_.reset();
    }
    pool_->Return(access_, std::move(connection_));
}

Lease ConnectionPool::Read() {
    {
        std::lock_guard lock(mutex_);
        if (!readers_.empty()) {
            Lease lease(*this, Access::kRead, std::move(readers_.back()));
            readers_.pop_back();
            return lease;
        }
    }
    return Lease(*this, Access::kRead, backend_.Connect(Access::kRead));
}

Lease ConnectionPool::Write() {
    std::unique_ptr<Connection> connection;
    {
        std::unique_lock lock(mutex_);
        const auto limit = std::chrono::system_clock::now() + kWriterWait;
        if (!writer_back_.wait_until(lock, limit, [this] { return !writing_; })) {
            throw base::RuntimeError(base::errors::kUnspecified, "The database is busy");
        }
        writing_ = true;
        connection = std::move(writer_);
    }
    try {
        if (!connection) {
            connection = backend_.Connect(Access::kWrite);
        }
    } catch (...) {
        Return(Access::kWrite, nullptr);
        throw;
    }
    return Lease(*this, Access::kWrite, std::move(connection));
}

void ConnectionPool::Return(Access access, std::unique_ptr<Connection> connection) {
    if (access == Access::kWrite) {
        ++writes_;
    }
    std::lock_guard lock(mutex_);
    if (access == Access::kWrite) {
        writer_ = std::move(connection);
        writing_ = false;
        writer_back_.notify_one();
    } else if (connection && readers_.size() < kIdleReaders) {
        readers_.push_back(std::move(connection));
    }
}

std::int64_t ConnectionPool::DataVersion() {
    const auto now = std::chrono::steady_clock::now();
    if (looked_writes_ == writes_ && now - looked_.load() < kLookTime) {
        return version_;
    }
    std::lock_guard lock(watch_mutex_);
    const std::int64_t writes = writes_;
    std::unique_ptr<Connection> watcher = std::move(watcher_);  // gone when it fails
    const bool is_new = !watcher;
    if (is_new) {
        watcher = backend_.Connect(Access::kRead);
    }
    const std::int64_t seen = watcher->DataVersion();
    if (is_new || seen != watched_) {
        watched_ = seen;
        ++version_;
    }
    watcher_ = std::move(watcher);
    looked_ = now;
    looked_writes_ = writes;
    return version_;
}

}  // namespace zebtell::erp
