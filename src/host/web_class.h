#pragma once

#include "host/session_state.h"

namespace zebtell::host {

// The life of a session's instance and of its requests, as the page runtime raises it.

void WebClass_Initialize(SessionState& state);
void WebClass_BeginRequest(SessionState& state, web::Call& call);
void WebClass_Start(SessionState& state, web::Call& call);
void WebClass_EndRequest(SessionState& state, web::Call& call);
// Logs the error and logs the user off; the runtime's own answer is left as it is.
void WebClass_FatalErrorResponse(SessionState& state,
                                 web::Call& call,
                                 const std::exception& error,
                                 bool& SendDefault);
void WebClass_Terminate(SessionState& state);

// The hooks for the page runtime.
web::WebClass<SessionState> WebClassHooks();

// A new session's state, initialised.
std::unique_ptr<SessionState> NewSession(Services& services);

}  // namespace zebtell::host
