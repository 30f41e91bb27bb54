#pragma once

#include "tags/tag_table.h"

namespace zebtell::tags {

// Decides whether the customer may order: by a field of his company ("OrdersAllowed"), or by a
// field of the current record of one of the page's queries ("query.field").
void EnableOrders(TagCall& call);

}  // namespace zebtell::tags
