#pragma once

#include <cstdint>
#include <string_view>

#include "tags/tag_table.h"

namespace zebtell::orders {

// One turn of a block that stands once for each basket row: makes the row under BasketRowCursor
// the current one, hides it when the customer's form leaves it alone, and comes again as `tag`
// until the row `last`.
bool BasketRowBlock(tags::TagCall& call, std::string_view tag, std::int64_t last);

}  // namespace zebtell::orders
