#pragma once

#include "tags/tag_table.h"

namespace zebtell::tags {

// "ZEB:Query": name;filter column;master;mode[;order[;masterq]]. An order "#Name" is the value of
// the address's parameter Name, so that a link can choose the order.
bool DefineQuery(TagCall& call);

bool ResetQuery(TagCall& call);
bool RequeryQuery(TagCall& call);
bool AdvanceQuery(TagCall& call);

// "ZEB:<query>.Row": the contents once for each record from the query's current one on; the
// template moves on with "ZEB:Query.Advance".
bool QueryRow(TagCall& call);

}  // namespace zebtell::tags
