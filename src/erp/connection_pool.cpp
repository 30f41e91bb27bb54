#include "erp/connection_pool.h"

#include <algorithm>

#include "base/runtime_error.h"

namespace zebtell::erp {
namespace {

using std::chrono::steady_clock;

// A look takes some 5 us; thousands of pages a second share it.
constexpr std::chrono::milliseconds kLookTime{1};

template <class Condition>
void WaitFor(std::condition_variable& change,
             std::unique_lock<std::mutex>& lock,
             std::chrono::milliseconds limit,
             const Condition& condition) {
    if (!change.wait_for(lock, limit, condition)) {
        throw base::RuntimeError(base::errors::kUnspecified, "The database is busy");
    }
}

}  // namespace

Lease::~Lease() {
    if (!connection_) {
        return;  // moved away
    }
    if (dropped_ || connection_->IsBroken()) {
        connection_.reset();
    }
    pool_->Return(access_, std::move(connection_));
}

Lease ConnectionPool::Read() {
    Idle idle = TakeReader();
    return {*this, Access::kRead, Ready(Access::kRead, std::move(idle))};
}

Lease ConnectionPool::Write() {
    Idle idle = TakeWriter();
    return {*this, Access::kWrite, Ready(Access::kWrite, std::move(idle))};
}

ConnectionPool::Idle ConnectionPool::TakeReader() {
    std::unique_lock lock(mutex_);
    WaitFor(reader_back_, lock, limits_.wait, [this] { return reading_ < limits_.readers; });
    ++reading_;
    if (readers_.empty()) {
        return {};
    }
    Idle idle = std::move(readers_.back());
    readers_.pop_back();
    return idle;
}

ConnectionPool::Idle ConnectionPool::TakeWriter() {
    std::unique_lock lock(mutex_);
    WaitFor(writer_back_, lock, limits_.wait, [this] { return !writing_; });
    writing_ = true;
    return std::move(writer_);
}

std::unique_ptr<Connection> ConnectionPool::Ready(Access access, Idle idle) {
    try {
        if (idle.connection && steady_clock::now() - idle.since > limits_.trusted &&
            !idle.connection->Answers()) {
            idle.connection.reset();
        }
        return idle.connection ? std::move(idle.connection) : backend_.Connect(access);
    } catch (...) {
        Return(access, nullptr);
        throw;
    }
}

void ConnectionPool::Return(Access access, std::unique_ptr<Connection> connection) {
    if (access == Access::kWrite) {
        ++writes_;
    }
    const Time now = steady_clock::now();
    std::vector<Idle> closed;  // without the lock, since it may take a while
    std::lock_guard lock(mutex_);
    if (access == Access::kWrite) {
        writer_ = {std::move(connection), now};
        writing_ = false;
        writer_back_.notify_one();
        return;
    }
    --reading_;
    reader_back_.notify_one();
    const auto fresh = std::find_if(readers_.begin(), readers_.end(), [&](const Idle& idle) {
        return now - idle.since < limits_.kept;
    });
    closed.assign(std::make_move_iterator(readers_.begin()), std::make_move_iterator(fresh));
    readers_.erase(readers_.begin(), fresh);
    if (connection) {
        readers_.push_back({std::move(connection), now});
    }
}

void ConnectionPool::CloseIdle() {
    std::vector<Idle> closed;
    std::lock_guard lock(mutex_);
    closed.swap(readers_);
}

void ConnectionPool::Renew() {
    CloseIdle();
    Read();
}

std::int64_t ConnectionPool::DataVersion() {
    const auto now = steady_clock::now();
    if (looked_writes_ == writes_ && now - looked_.load() < kLookTime) {
        return version_;
    }
    std::lock_guard lock(watch_mutex_);
    const std::int64_t writes = writes_;
    std::unique_ptr<CommitWatch> watch = std::move(watch_);  // gone when it fails
    const bool is_new = !watch;
    if (is_new) {
        watch = backend_.WatchCommits();
    }
    const std::int64_t seen = watch->DataVersion();
    if (is_new || seen != watched_ || writes != looked_writes_) {
        watched_ = seen;
        ++version_;
    }
    watch_ = std::move(watch);
    looked_ = now;
    looked_writes_ = writes;
    return version_;
}

}  // namespace zebtell::erp
