#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "http/message.h"
#include "markup/template_cache.h"
#include "web/request_cycle.h"
#include "web/session_store.h"
#include "web/site.h"
#include "web/worker_pool.h"

namespace zebtell::web {

struct RuntimeOptions {
    std::string base_path = "/";  // begins with "/"
    std::chrono::minutes session_idle{20};
    std::size_t max_sessions = 10'000;
    std::size_t queue_limit = 32;  // requests of one session that wait
    int most_log_ons = 64;         // that wait or run, of all sessions; more are told to come again
    unsigned worker_threads = 0;   // 0: one for each core
    // False when every request can wait, as with a database over the network: then none runs on the
    // thread that read it.
    bool quick_on_io_threads = true;
    // Tried first: style sheets, health, metrics. May not block.
    std::function<std::optional<http::Response>(const http::Request&)> static_files;
    // Told what nobody else hears of: a session's state that could not be made. Any thread.
    std::function<void(std::string_view)> log;
    SessionStore::Clock clock = std::chrono::steady_clock::now;
};

// Answers the requests for a site's pages: finds the session, waits for its turn, runs the request
// cycle. Any thread may call Handle.
class SiteRuntime {
  public:
    // RuntimeError 5 for a base path without its "/". `templates` must outlive the runtime.
    SiteRuntime(Site site, markup::TemplateCache& templates, RuntimeOptions options);
    ~SiteRuntime();  // stops
    SiteRuntime(const SiteRuntime&) = delete;
    SiteRuntime& operator=(const SiteRuntime&) = delete;

    void Handle(const http::Request& request, http::Responder respond);

    // Finishes the requests that wait and ends all sessions' instances. Handle must not be called
    // any more: stop the server first.
    void Stop();

    SessionStore::Counts CountSessions() const { return sessions_.Count(); }

  private:
    struct Job;

    std::shared_ptr<Session> SessionFor(const http::Request& request, std::string& new_token);
    std::shared_ptr<void> TakePlace();
    Work WorkOf(const Request& request) const;
    void Run(Job& job);
    http::Response RunPage(Job& job);

    const Site site_;
    const RuntimeOptions options_;
    const CycleContext context_;
    std::atomic<int> log_ons_ = 0;  // that wait or run
    WorkerPool pool_;
    SessionStore sessions_;
};

}  // namespace zebtell::web
