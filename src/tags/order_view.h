#pragma once

#include "tags/tag_table.h"

namespace zebtell::tags {

// The tags that show the stored order of the session: header, rows, tax lines. The order view page
// and the page after a confirmation share them.
const TagTable& OrderViewTagTable();

// Loads the order that the session's ShownOrderFilter names, unless it is there already.
// RuntimeError when the customer has no such order.
void ReadShownOrder(host::SessionState& state);

// The row and tax blocks begin with their first lines again.
void RewindOrderView(host::SessionState& state);

}  // namespace zebtell::tags
