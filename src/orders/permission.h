#pragma once

#include "host/session_state.h"

namespace zebtell::orders {

// Whether the templates have decided that this customer may not order; then the session's Message
// says so. Asks the page's template when none has decided yet, so that a form that comes before
// any page is no way around it. Templates that never decide let everybody order.
bool RefusesOrders(host::SessionState& state, web::Call& call);

}  // namespace zebtell::orders
