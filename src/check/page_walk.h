#pragma once

#include <span>

#include "check/page_reading.h"

namespace zebtell::check {

// Reads a page's template from its beginning to its end, and reports what is wrong with its tags,
// its fields and its addresses.
void WalkPage(PageReading& reading, std::span<const CheckedPage> pages);

}  // namespace zebtell::check
