#pragma once

#include <functional>
#include <memory>
#include <stdexcept>
#include <utility>
#include <vector>

#include "base/ignore_errors.h"
#include "web/page.h"
#include "web/site_runtime.h"

namespace zebtell::web {

// A session's State as the runtime holds it.
template <class State>
class StateInstance final : public SessionInstance {
  public:
    StateInstance(std::unique_ptr<State> state, void (*terminate)(State&))
        : state_(std::move(state)), terminate_(terminate) {}
    ~StateInstance() override {
        // Nobody is left to tell.
        if (terminate_ != nullptr) base::IgnoreErrors([this] { terminate_(*state_); });
    }

    static State& Of(SessionInstance& instance) {
        return *static_cast<StateInstance&>(instance).state_;
    }
    static const State& Of(const SessionInstance& instance) {
        return *static_cast<const StateInstance&>(instance).state_;
    }

  private:
    const std::unique_ptr<State> state_;
    void (*const terminate_)(State&);
};

// `function` with its State& taken from the instance; empty for null.
template <class State, class Result, class... Args>
std::function<Result(SessionInstance&, Args...)> OnInstance(Result (*function)(State&, Args...)) {
    if (function == nullptr) return nullptr;
    return [function](SessionInstance& instance, Args... args) {
        return function(StateInstance<State>::Of(instance), std::forward<Args>(args)...);
    };
}

// The same for what only reads the State.
template <class State, class Result>
std::function<Result(const SessionInstance&)> OnConstInstance(Result (*function)(const State&)) {
    if (function == nullptr) return nullptr;
    return [function](const SessionInstance& instance) {
        return function(StateInstance<State>::Of(instance));
    };
}

template <class State>
Site MakeSite(const std::vector<Page<State>>& table,
              const WebClass<State>& web_class,
              std::function<std::unique_ptr<State>()> make_state) {
    std::vector<SitePage> pages;
    for (const Page<State>& row : table) {
        SitePage page{.name = std::string(row.name),
                      .template_file = std::string(row.template_file),
                      .respond = OnInstance(row.Respond),
                      .process_tag = OnInstance(row.ProcessTag),
                      .user_event = OnInstance(row.UserEvent),
                      .events = {},
                      .rules = row.rules};
        for (const PageEvent<State>& event : row.events) {
            page.events.push_back(
                {std::string(event.name), OnInstance(event.handle), event.work, event.effect});
        }
        pages.push_back(std::move(page));
    }
    SiteHooks hooks{.make_instance =
                        [make = std::move(make_state), terminate = web_class.Terminate] {
                            return std::make_unique<StateInstance<State>>(make(), terminate);
                        },
                    .begin_request = OnInstance(web_class.BeginRequest),
                    .start = OnInstance(web_class.Start),
                    .end_request = OnInstance(web_class.EndRequest),
                    .fatal = OnInstance(web_class.FatalErrorResponse),
                    .standing_of = OnConstInstance(web_class.StandingOf),
                    .check_logon = OnInstance(web_class.CheckLogon),
                    .language = OnConstInstance(web_class.Language)};
    return Site(std::move(pages), std::move(hooks));
}

// The page runtime of a site whose sessions hold a State. `make_state` makes one for a session's
// first request, on the thread that runs it. Throws std::logic_error for a table with a page, or
// an event of a page, twice.
template <class State>
class PageRuntime : public SiteRuntime {
  public:
    PageRuntime(const std::vector<Page<State>>& pages,
                const WebClass<State>& web_class,
                std::function<std::unique_ptr<State>()> make_state,
                markup::TemplateCache& templates,
                RuntimeOptions options)
        : SiteRuntime(MakeSite<State>(pages, web_class, std::move(make_state)),
                      templates,
                      std::move(options)) {}

    // An http::Handler: `[&runtime](auto request, auto respond) { runtime(...); }`.
    void operator()(const http::Request& request, http::Responder respond) {
        Handle(request, std::move(respond));
    }
};

}  // namespace zebtell::web
