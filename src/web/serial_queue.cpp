#include "web/serial_queue.h"

#include <utility>

namespace zebtell::web {

bool SerialQueue::Submit(Task task, Work work) {
    std::unique_lock lock(mutex_);
    if (is_running_) {
        if (waiting_.size() >= limit_) return false;
        waiting_.push_back(std::move(task));
        return true;
    }
    is_running_ = true;
    if (work == Work::kMayWait) {
        waiting_.push_back(std::move(task));
        lock.unlock();
        PostNext();
        return true;
    }
    lock.unlock();
    task();
    Finish();
    return true;
}

void SerialQueue::PostNext() {
    pool_.Post([self = shared_from_this()] { self->RunOne(); });
}

void SerialQueue::RunOne() {
    Task task;
    {
        const std::lock_guard lock(mutex_);
        task = std::move(waiting_.front());
        waiting_.erase(waiting_.begin());
    }
    task();
    Finish();
}

// Sessions take turns: what waits goes to the end of the pool's queue.
void SerialQueue::Finish() {
    {
        const std::lock_guard lock(mutex_);
        if (waiting_.empty()) {
            is_running_ = false;
            return;
        }
    }
    PostNext();
}

}  // namespace zebtell::web
