#pragma once

#include <atomic>
#include <boost/asio/executor_work_guard.hpp>
#include <boost/asio/steady_timer.hpp>
#include <chrono>
#include <memory>
#include <thread>
#include <unordered_set>

#include "http/asio_types.h"
#include "http/body_budget.h"
#include "http/client_address.h"
#include "http/connection_count.h"
#include "http/response_head.h"
#include "http/server.h"

namespace zebtell::http {

class Connection;

// What the connections of a server share.
struct ServerContext {
    ServerContext(ServerOptions o, Handler h)
        : options(std::move(o)),
          handler(std::move(h)),
          proxies(options.trusted_proxies),
          bodies(options.limits.body_bytes_in_all) {}

    const ServerOptions options;
    const Handler handler;
    const TrustedProxies proxies;
    ConnectionCount connections;
    BodyBudget bodies;

    // Three quarters of the places for connections are taken: those that only wait give way.
    bool IsCrowded() const { return connections.Total() > options.limits.connections / 4 * 3; }

    void Log(std::string_view text) const {
        if (options.log) options.log(text);
    }
};

// One IO thread and its connections. Connections keep their worker alive, since their sockets are
// registered with it; so nothing that waits in the worker's own queue when the thread has ended may
// own a connection.
class Worker : public std::enable_shared_from_this<Worker> {
  public:
    using Clock = std::chrono::steady_clock;

    explicit Worker(std::shared_ptr<ServerContext> context);

    void Start();
    // From any thread, once: lets requests under way finish, then the thread ends.
    void BeginStop();
    void Join();

    asio::io_context& io() { return io_; }
    ServerContext& context() { return *context_; }

    // The others are for the worker's own thread.
    void Add(std::shared_ptr<Connection> connection);
    void Remove(const std::shared_ptr<Connection>& connection);
    bool stopping() const { return stopping_; }
    std::string_view Date() { return date_.Now(); }

  private:
    using Connections = std::unordered_set<std::shared_ptr<Connection>>;

    void Run();
    void ScheduleSweep(Clock::duration wait);
    void Sweep();
    void EndWhenEmpty();

    std::shared_ptr<ServerContext> context_;
    asio::io_context io_{1};
    asio::executor_work_guard<Executor> work_{io_.get_executor()};
    asio::basic_waitable_timer<Clock, asio::wait_traits<Clock>, Executor> sweep_timer_{io_};
    Clock::duration sweep_interval_;
    DateHeader date_;
    Connections connections_;
    bool stopping_ = false;
    Clock::time_point stop_deadline_;
    std::thread thread_;
};

}  // namespace zebtell::http
