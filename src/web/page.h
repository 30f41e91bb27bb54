#pragma once

#include <exception>
#include <string_view>
#include <vector>

#include "markup/tag.h"
#include "web/call.h"

namespace zebtell::web {

// Whether a handler can hold its thread up (a commit, a search over a whole list, a database on the
// network) and so may not run on an IO thread; a log-on, which takes processor time on purpose, has
// threads of its own.
enum class Work { kQuick, kMayWait, kLogOn };

// Who a session is to the server, from the first to go when there are too many to the last.
enum class Standing { kAnonymous, kGuest, kUser };

// Who may ask for a page: without a log-on nobody reaches a handler or a tag of a page that is for
// kLoggedOn.
enum class Visitors { kLoggedOn, kEverybody };

// Whether a request only shows something or changes what the user owns: his basket, his orders,
// his log-on. A request that changes something is refused when another site sent it, and a post
// always counts as one.
enum class Effect { kShows, kChanges };

template <class State>
struct PageEvent {
    std::string_view name;
    void (*handle)(State&, Call&);
    Work work = Work::kQuick;
    Effect effect = Effect::kChanges;
};

// The defaults are the strict ones, so that a forgotten word refuses too much.
struct PageRules {
    Visitors visitors = Visitors::kLoggedOn;
    Effect respond = Effect::kShows;
    Effect user_event = Effect::kChanges;
};

// One page: its name, its template and its handlers. State is what a session holds.
template <class State>
struct Page {
    std::string_view name;
    std::string_view template_file;
    void (*Respond)(State&, Call&) = nullptr;
    // Null: every tag leaves its contents.
    void (*ProcessTag)(State&, Call&, markup::Tag&) = nullptr;
    // For event names made at run time. Null: such events show the page's template.
    void (*UserEvent)(State&, Call&, std::string_view event) = nullptr;
    std::vector<PageEvent<State>> events;
    PageRules rules = {};
};

// What the runtime raises on the application around the pages.
template <class State>
struct WebClass {
    void (*BeginRequest)(State&, Call&);
    void (*Start)(State&, Call&);  // a request that names no page
    void (*EndRequest)(State&, Call&);
    // An error that no handler caught; the runtime sends its own answer unless SendDefault is
    // made false.
    void (*FatalErrorResponse)(State&, Call&, const std::exception& error, bool& SendDefault);
    void (*Terminate)(State&);
    Standing (*StandingOf)(const State&);
    // For pages that are for kLoggedOn: whether the request may go on. When not, the response is
    // written. Null: everybody may.
    bool (*CheckLogon)(State&, Call&) = nullptr;
    // The language of the session's pages, as templates' catalogues are named. Null: templates as
    // they are written.
    std::string_view (*Language)(const State&) = nullptr;
};

}  // namespace zebtell::web
