#pragma once

#include "host/session_state.h"

namespace zebtell::host {

void Logon_Respond(SessionState& state, web::Call& call);

// The log-on form was posted: blocking of repeated failures, the guest rule, the log-on itself.
void Logon_Logon(SessionState& state, web::Call& call);

void Logout_Respond(SessionState& state, web::Call& call);

// The logout page's link back to the log-on form.
void Logout_Hyperlink2(SessionState& state, web::Call& call);

}  // namespace zebtell::host
