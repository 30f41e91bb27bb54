#pragma once

#include "host/session_state.h"
#include "tags/tag_table.h"

namespace zebtell::documents {

// The start page: the customer's last orders, to be looked at and ordered again.
void Raamistik_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag);
const tags::TagTable& RaamistikTagTable();

}  // namespace zebtell::documents
