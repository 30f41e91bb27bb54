#include "web/serial_queue.h"

#include <utility>

namespace zebtell::web {

bool SerialQueue::Submit(Task task, Work work) {
    std::unique_lock lock(mutex_);
    if (is_running_) {
        if (waiting_.size() >= limit_) return false;
        waiting_.push_back({std::move(task), work});
        return true;
    }
    is_running_ = true;
    if (work != Work::kQuick) {
        waiting_.push_back({std::move(task), work});
        lock.unlock();
        PostNext(work);
        return true;
    }
    lock.unlock();
    task();
    Finish();
    return true;
}

void SerialQueue::PostNext(Work work) {
    pool_.Post([self = shared_from_this()] { self->RunOne(); }, work);
}

void SerialQueue::RunOne() {
    Task task;
    {
        const std::lock_guard lock(mutex_);
        task = std::move(waiting_.front().task);
        waiting_.erase(waiting_.begin());
    }
    task();
    Finish();
}

// Sessions take turns: what waits goes to the end of the pool's queue.
void SerialQueue::Finish() {
    Work next = Work::kMayWait;
    {
        const std::lock_guard lock(mutex_);
        if (waiting_.empty()) {
            is_running_ = false;
            return;
        }
        next = waiting_.front().work;
    }
    PostNext(next);
}

}  // namespace zebtell::web
