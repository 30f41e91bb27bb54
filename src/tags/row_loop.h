#pragma once

#include "tags/tag_table.h"

namespace zebtell::tags {

// The basket's rows as the order summary tags show them, one after the other in
// BasketFormState::RowIndex. Rows that the customer's form leaves alone are passed over, but keep
// their numbers.
void ReadRows(TagCall& call);
void ReadNextRow(TagCall& call);

}  // namespace zebtell::tags
