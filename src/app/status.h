#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <optional>

#include "erp/database.h"
#include "host/settings.h"
#include "http/message.h"
#include "markup/template_cache.h"
#include "web/session_store.h"

namespace zebtell::app {

// /healthz and /metrics, for whoever watches over the portal: this machine only, unless that was
// opened. Others get what any unknown path gets. Thread-safe.
class Status {
  public:
    struct Sources {
        erp::Databases& databases;
        markup::TemplateCache& templates;
        host::SettingsStore& settings;
        bool is_public = false;
        std::function<web::SessionStore::Counts()> count_sessions;
    };

    explicit Status(Sources sources) : sources_(std::move(sources)) {}

    // Nothing for other paths. Also counts the request.
    std::optional<http::Response> Serve(const http::Request& request);

  private:
    http::Response Health() const;
    http::Response Metrics() const;

    const Sources sources_;
    std::atomic<std::uint64_t> requests_ = 0;
};

}  // namespace zebtell::app
