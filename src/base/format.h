#pragma once

#include <string>
#include <string_view>

#include "base/region.h"
#include "base/value.h"

namespace zebtell::base {

// The value written by a picture ("0.00", "dd.mm.yyyy", ">@@@") or a named format ("Fixed",
// "Short Date"), names and letters without regard to case. Weeks start on Sunday; the first week
// holds the 1st of January. Rounds half away from zero. Null gives "" unless the picture has a
// fourth section; an empty picture gives the value as text. Text that is neither a number nor a
// date, and numbers beyond the calendar, are returned as text by pictures that need one.
std::string Format(const Value& value, std::string_view picture, const Region& region);

}  // namespace zebtell::base
