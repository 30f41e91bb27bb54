#pragma once

#include <string_view>

#include "host/session_state.h"
#include "tags/tag_table.h"

namespace zebtell::catalogue {

// The article information page.

void KInfo_Respond(host::SessionState& state, web::Call& call);
void KInfo_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);
// Any event: shows the article that the request value "ID" names.
void KInfo_UserEvent(host::SessionState& state, web::Call& call, std::string_view event);

const tags::TagTable& KInfoTagTable();

}  // namespace zebtell::catalogue
