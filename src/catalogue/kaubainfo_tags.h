#pragma once

#include "tags/tag_table.h"

namespace zebtell::catalogue {

// The catalogue page's own tags.
const tags::TagTable& KaubainfoTagTable();

}  // namespace zebtell::catalogue
