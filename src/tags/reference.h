#pragma once

#include <ostream>
#include <string_view>

#include "tags/tag_table.h"

namespace zebtell::tags {

// The table as text for the command line and the manual, one line a tag:
//
//   Common tags
//     ZEB:WEBGuest        Contents for the guest only
void PrintReference(std::ostream& out, std::string_view title, const TagTable& table);

}  // namespace zebtell::tags
