#pragma once

#include <string_view>

#include "host/session_state.h"
#include "tags/tag_table.h"

namespace zebtell::orders {

// The composition page: the basket row by row.

void Koostamine_Respond(host::SessionState& state, web::Call& call);
void Koostamine_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);
// "DEL_" and a row's position: takes that row out. The request value "Next" may lead back to
// "Kaubainfo" instead of here.
void Koostamine_UserEvent(host::SessionState& state, web::Call& call, std::string_view event);
// The form's buttons: more rows, go on, or drop the order.
void Koostamine_Vormista(host::SessionState& state, web::Call& call);

const tags::TagTable& KoostamineTagTable();

}  // namespace zebtell::orders
