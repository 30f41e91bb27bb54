#pragma once

#include <string_view>

#include "host/session_state.h"

namespace zebtell::documents {

// The order view page: one stored order of the customer's company.

void Tellimus_Respond(host::SessionState& state, web::Call& call);
void Tellimus_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);
// "ID_" and an order's ID: shows that order.
void Tellimus_UserEvent(host::SessionState& state, web::Call& call, std::string_view event);

}  // namespace zebtell::documents
