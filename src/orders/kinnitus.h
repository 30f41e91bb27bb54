#pragma once

#include <string_view>

#include "host/session_state.h"
#include "tags/tag_table.h"

namespace zebtell::orders {

// The confirmation page: the basket once more, then the order stands in the database.

void Kinnitus_Respond(host::SessionState& state, web::Call& call);
void Kinnitus_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);
// "New": an empty basket. "ID_" and an order's ID: that stored order as the basket. "COPY_" and an
// order's ID: its rows in a new basket, at today's prices.
void Kinnitus_UserEvent(host::SessionState& state, web::Call& call, std::string_view event);
// The form's buttons: back, store, drop.
void Kinnitus_LisaTellimus(host::SessionState& state, web::Call& call);

// The page behind a stored order.
void Kinnitatud_Respond(host::SessionState& state, web::Call& call);
void Kinnitatud_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);
void Kinnitatud_UserEvent(host::SessionState& state, web::Call& call, std::string_view event);

const tags::TagTable& KinnitusTagTable();

}  // namespace zebtell::orders
