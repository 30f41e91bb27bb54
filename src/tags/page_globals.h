#pragma once

#include <string>

#include "host/session_state.h"

namespace zebtell::tags {

// What the templates of a thread's current page have declared, and the log-on method that they
// offer. A thread serves one page at a time and many sessions in turn.
extern thread_local std::string PageLanguage;  // "ZEB:WEBLanguage"; "" until the page says it
extern thread_local bool IDCardLogon;          // ID card instead of password

// Begins a request on this thread: nothing of another session's page is left, and the log-on
// method is the settings'.
void ResetPageGlobals(const host::Settings& settings);

// The host's hooks, with the page globals reset at the begin of every request.
web::WebClass<host::SessionState> WebClassHooks();

}  // namespace zebtell::tags
