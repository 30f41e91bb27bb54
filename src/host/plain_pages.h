#pragma once

#include "host/session_state.h"

namespace zebtell::host {

// Pages that only show their template; they stand open to everybody, so their templates show a
// customer's data only inside tags that are empty for nobody.
void Raamistik_Respond(SessionState& state, web::Call& call);
void Vasak_Respond(SessionState& state, web::Call& call);

// The navigation's own link: the body frame's start page.
void Vasak_Body1(SessionState& state, web::Call& call);

// The one plain page that is for users.
void Yld_Respond(SessionState& state, web::Call& call);

}  // namespace zebtell::host
