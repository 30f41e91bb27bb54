#include "web/worker_pool.h"

#include <algorithm>
#include <boost/asio/post.hpp>
#include <boost/asio/steady_timer.hpp>
#include <boost/asio/strand.hpp>
#include <boost/asio/thread_pool.hpp>
#include <deque>

namespace zebtell::web {

namespace asio = boost::asio;

class WorkerPool::Impl {
  public:
    explicit Impl(unsigned threads) : pool_(std::max(threads, 1U)) {}

    void Post(std::function<void()> task) { asio::post(pool_, std::move(task)); }

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
    asio::strand<asio::thread_pool::executor_type> timers_strand_{pool_.get_executor()};
    // Used within the strand only.
    std::deque<Repeated> timers_;
    bool stopping_ = false;
};

WorkerPool::WorkerPool(unsigned threads) : impl_(std::make_unique<Impl>(threads)) {}

WorkerPool::~WorkerPool() {
    Stop();
}

void WorkerPool::Post(std::function<void()> task) {
    impl_->Post(std::move(task));
}

void WorkerPool::Every(std::chrono::milliseconds period, std::function<void()> task) {
    impl_->Every(period, std::move(task));
}

void WorkerPool::Stop() {
    impl_->Stop();
}

}  // namespace zebtell::web
