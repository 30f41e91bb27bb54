#include "http/worker.h"

#include <algorithm>
#include <boost/asio/post.hpp>
#include <vector>

#include "http/connection.h"

namespace zebtell::http {
namespace {

constexpr std::chrono::milliseconds kStopSweep(10);

// Deadlines are looked after now and then, not by a timer for each: setting one costs more than
// the rest of a small request. They are kept to within a quarter of the shortest.
Worker::Clock::duration SweepInterval(const Timeouts& timeouts) {
    const auto shortest =
        std::min({timeouts.head, timeouts.body, timeouts.idle, timeouts.write, timeouts.linger});
    return std::clamp(shortest / 4, kStopSweep, std::chrono::milliseconds(1000));
}

}  // namespace

Worker::Worker(std::shared_ptr<ServerContext> context)
    : context_(std::move(context)), sweep_interval_(SweepInterval(context_->options.timeouts)) {}

void Worker::Start() {
    ScheduleSweep(sweep_interval_);
    thread_ = std::thread([this] { Run(); });
}

void Worker::Run() {
    for (;;) {
        try {
            io_.run();
            return;
        } catch (const std::exception& error) {
            context_->Log(std::string("IO thread: ") + error.what());
        }
    }
}

void Worker::Join() {
    if (thread_.joinable()) thread_.join();
}

void Worker::Add(std::shared_ptr<Connection> connection) {
    connections_.insert(std::move(connection));
}

void Worker::Remove(const std::shared_ptr<Connection>& connection) {
    connections_.erase(connection);
    EndWhenEmpty();
}

void Worker::ScheduleSweep(Clock::duration wait) {
    sweep_timer_.expires_after(wait);
    sweep_timer_.async_wait([this](const error_code& error) {
        if (!error) Sweep();
    });
}

void Worker::Sweep() {
    // Cancelling comes too late for a timer that was due at the same time as the last close.
    if (!work_.owns_work()) return;
    const auto now = Clock::now();
    const bool is_over = stopping_ && now >= stop_deadline_;
    const bool is_crowded = context_->IsCrowded();
    // They leave the set while they are being looked after.
    std::vector<std::shared_ptr<Connection>> overdue;
    for (const auto& connection : connections_) {
        if (is_over || connection->IsOverdue(now, is_crowded)) overdue.push_back(connection);
    }
    ScheduleSweep(stopping_ ? kStopSweep : sweep_interval_);
    for (const auto& connection : overdue) {
        if (is_over) {
            connection->Close();
        } else {
            connection->OnOverdue();
        }
    }
}

void Worker::BeginStop() {
    asio::post(io_, [this] {
        stopping_ = true;
        stop_deadline_ = Clock::now() + context_->options.timeouts.stop;
        ScheduleSweep(kStopSweep);
        const std::vector<std::shared_ptr<Connection>> all(connections_.begin(),
                                                           connections_.end());
        for (const auto& connection : all) connection->CloseWhenIdle();
        EndWhenEmpty();
    });
}

void Worker::EndWhenEmpty() {
    if (!stopping_ || !connections_.empty()) return;
    sweep_timer_.cancel();
    work_.reset();
}

}  // namespace zebtell::http
