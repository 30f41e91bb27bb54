#pragma once

#include "host/session_state.h"

namespace zebtell::orders {

// The catalogue's form with quantities: everything typed goes into the basket at once.
void Kaubainfo_Lisamine(host::SessionState& state, web::Call& call);

}  // namespace zebtell::orders
