#include "web/worker_pool.h"

#include <sys/resource.h>

#include <algorithm>
#include <boost/asio/executor_work_guard.hpp>
#include <boost/asio/post.hpp>
#include <boost/asio/steady_timer.hpp>
#include <boost/asio/strand.hpp>
#include <boost/asio/thread_pool.hpp>
#include <deque>

namespace zebtell::web {

namespace asio = boost::asio;

namespace {

// Of the calling thread, once; where that is not allowed, all threads are equal.
void LowerPriority() {
    constexpr int kNiceness = 5;
    static thread_local const int lowered = ::setpriority(PRIO_PROCESS, 0, kNiceness);
    static_cast<void>(lowered);
}

}  // namespace

class WorkerPool::Impl {
  public:
    Impl(unsigned threads, unsigned log_on_threads)
        : pool_(std::max(threads, 1U)), log_ons_(std::max(log_on_threads, 1U)) {}

    void Post(std::function<void()> task, Work work) {
        if (work != Work::kLogOn) return asio::post(pool_, std::move(task));
        // Each keeps the pool open: what follows it in its session may run there.
        auto keeps_open = asio::make_work_guard(pool_);
        asio::post(log_ons_, [task = std::move(task), keeps_open = std::move(keeps_open)] {
            LowerPriority();
            task();
        });
    }

    void Every(std::chrono::milliseconds period, std::function<void()> task) {
        asio::post(timers_strand_, [this, period, task = std::move(task)]() mutable {
            timers_.push_back({asio::steady_timer(timers_strand_), period, std::move(task)});
            Schedule(timers_.size() - 1);
        });
    }

    void Stop() {
        asio::post(timers_strand_, [this] {
            stopping_ = true;
            for (Repeated& repeated : timers_) repeated.timer.cancel();
        });
        pool_.join();
        log_ons_.join();
    }

  private:
    struct Repeated {
        asio::steady_timer timer;
        std::chrono::milliseconds period;
        std::function<void()> task;
    };

    void Schedule(std::size_t number) {
        if (stopping_) return;
        timers_[number].timer.expires_after(timers_[number].period);
        timers_[number].timer.async_wait([this, number](const boost::system::error_code& error) {
            if (error) return;
            timers_[number].task();
            Schedule(number);
        });
    }

    asio::thread_pool pool_;
    asio::thread_pool log_ons_;
    asio::strand<asio::thread_pool::executor_type> timers_strand_{pool_.get_executor()};
    // Used within the strand only.
    std::deque<Repeated> timers_;
    bool stopping_ = false;
};

WorkerPool::WorkerPool(unsigned threads, unsigned log_on_threads)
    : impl_(std::make_unique<Impl>(threads, log_on_threads)) {}

WorkerPool::~WorkerPool() {
    Stop();
}

void WorkerPool::Post(std::function<void()> task, Work work) {
    impl_->Post(std::move(task), work);
}

void WorkerPool::Every(std::chrono::milliseconds period, std::function<void()> task) {
    impl_->Every(period, std::move(task));
}

void WorkerPool::Stop() {
    impl_->Stop();
}

}  // namespace zebtell::web
