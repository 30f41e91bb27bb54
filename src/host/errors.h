#pragma once

#include <concepts>
#include <exception>
#include <string>
#include <string_view>

#include "host/session_state.h"

namespace zebtell::host {

// The plain page that a handler shows when it cannot go on, and its log entry.
void WriteErrorPage(SessionState& state, web::Call& call, const std::exception& error);

// "Kaubainfo_Otsing error:" and the description, for those who read the log in detail.
void LogHandlerError(const SessionState& state,
                     std::string_view handler,
                     const std::exception& error);

// The one place where a page's handlers catch: runs `work`; an error is logged under the handler's
// name, then `instead` runs, with the error when it takes one. Returns whether the work came to its
// end.
template <class Work, class Instead>
bool Guarded(SessionState& state, std::string_view handler, Work&& work, Instead&& instead) {
    try {
        work();
        return true;
    } catch (const std::exception& error) {
        LogHandlerError(state, handler, error);
        if constexpr (std::invocable<Instead, const std::exception&>) {
            instead(error);
        } else {
            instead();
        }
        return false;
    }
}
template <class Work>
bool Guarded(SessionState& state, std::string_view handler, Work&& work) {
    return Guarded(state, handler, work, [] {});
}

// For handlers that only show their page: an error becomes the error page.
template <class Work>
void OrErrorPage(SessionState& state, web::Call& call, Work&& work) {
    try {
        work();
    } catch (const std::exception& error) {
        WriteErrorPage(state, call, error);
    }
}

// Writes the page's template into a response that nobody keeps.
void ShowPage(SessionState& state, web::Call& call);

}  // namespace zebtell::host
