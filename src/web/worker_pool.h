#pragma once

#include <chrono>
#include <functional>
#include <memory>

namespace zebtell::web {

// The threads for work that may wait. Tasks may not throw.
class WorkerPool {
  public:
    explicit WorkerPool(unsigned threads);  // at least one
    ~WorkerPool();                          // stops
    WorkerPool(const WorkerPool&) = delete;
    WorkerPool& operator=(const WorkerPool&) = delete;

    void Post(std::function<void()> task);
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
