#pragma once

#include <string_view>

#include "host/session_state.h"

namespace zebtell::catalogue {

// The catalogue page: the customer's price list by category, search and favourites, page by page.

void Kaubainfo_Respond(host::SessionState& state, web::Call& call);
void Kaubainfo_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);

// "ID_" and a row's ID: adds that article. "...Page": turns the page.
void Kaubainfo_UserEvent(host::SessionState& state, web::Call& call, std::string_view event);

void Kaubainfo_Favorites(host::SessionState& state, web::Call& call);
void Kaubainfo_Hinnakiri(host::SessionState& state, web::Call& call);
void Kaubainfo_Otsing(host::SessionState& state, web::Call& call);
void Kaubainfo_Navigate(host::SessionState& state, web::Call& call);

}  // namespace zebtell::catalogue
