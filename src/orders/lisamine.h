#pragma once

#include <string_view>

#include "host/session_state.h"
#include "tags/tag_table.h"

namespace zebtell::orders {

// The page that adds one article of the price list, and the page behind it.

void Lisamine_Respond(host::SessionState& state, web::Call& call);
void Lisamine_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);
// "ID_" and a price line's ID: chooses the article.
void Lisamine_UserEvent(host::SessionState& state, web::Call& call, std::string_view event);
// The form was posted: the row goes into the basket.
void Lisamine_Lisamine(host::SessionState& state, web::Call& call);

void Lisatud_Respond(host::SessionState& state, web::Call& call);

const tags::TagTable& LisamineTagTable();

}  // namespace zebtell::orders
