#pragma once

#include <exception>
#include <string>
#include <string_view>

#include "http/message.h"
#include "markup/template_cache.h"
#include "web/site.h"

namespace zebtell::web {

// What a cycle reads, the same for all requests of a site.
struct CycleContext {
    const Site& site;
    markup::TemplateCache& templates;
    const std::string& base_path;
};

struct CycleResult {
    http::Response response;
    bool release_instance = false;
    bool renew_token = false;
};

// One request from BeginRequest to EndRequest. Whatever the handlers throw ends as a page of its
// own and not as an exception.
CycleResult RunCycle(const CycleContext& context,
                     const Request& request,
                     SessionInstance& instance,
                     const std::string& session_id);

}  // namespace zebtell::web
