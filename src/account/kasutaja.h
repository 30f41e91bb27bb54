#pragma once

#include "host/session_state.h"

namespace zebtell::account {

// Who is logged on. The page stands open; its template shows a user's data only inside tags that
// are empty for nobody.
void Kasutaja_Respond(host::SessionState& state, web::Call& call);
void Kasutaja_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);

}  // namespace zebtell::account
