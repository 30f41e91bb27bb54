#pragma once

#include <chrono>
#include <functional>
#include <memory>

#include "web/page.h"

namespace zebtell::web {

// The threads for work that may wait, and fewer of them, at a lower priority, for log-ons: however
// many passwords are being hashed, pages have the processor first. Tasks may not throw.
class WorkerPool {
  public:
    // At least one of each kind.
    explicit WorkerPool(unsigned threads, unsigned log_on_threads = 1);
    ~WorkerPool();  // stops
    WorkerPool(const WorkerPool&) = delete;
    WorkerPool& operator=(const WorkerPool&) = delete;

    void Post(std::function<void()> task, Work work = Work::kMayWait);
    // Runs a task again and again until the pool stops. Call it before Stop.
    void Every(std::chrono::milliseconds period, std::function<void()> task);

    // Ends the timers, runs everything posted so far and what that posts, and ends the threads.
    // What is posted later is dropped.
    void Stop();

  private:
    class Impl;
    std::unique_ptr<Impl> impl_;
};

}  // namespace zebtell::web
