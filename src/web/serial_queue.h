#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <mutex>
#include <vector>

#include "web/page.h"
#include "web/worker_pool.h"

namespace zebtell::web {

// One session's requests: one at a time, in order of arrival, on any thread of the pool. Each task
// sees what the tasks before it have done. Held by a shared_ptr; the pool must outlive it.
class SerialQueue : public std::enable_shared_from_this<SerialQueue> {
  public:
    using Task = std::function<void()>;  // may not throw

    // At most `limit` tasks wait behind the one that runs.
    SerialQueue(WorkerPool& pool, std::size_t limit) : pool_(pool), limit_(limit) {}

    // False when the queue is full; the task is then left alone. A quick task runs before this
    // returns, on this thread, when nothing is before it.
    bool Submit(Task task, Work work);

  private:
    struct Waiting {
        Task task;
        Work work;
    };

    void PostNext(Work work);
    void RunOne();  // on the pool
    void Finish();

    WorkerPool& pool_;
    const std::size_t limit_;
    std::mutex mutex_;
    bool is_running_ = false;       // a task runs or the next one is posted
    std::vector<Waiting> waiting_;  // the first is next
};

}  // namespace zebtell::web
