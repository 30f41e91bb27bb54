#pragma once

#include <string>
#include <string_view>

#include "base/date_time.h"
#include "base/region.h"

namespace zebtell::base {

// The date written by a date picture ("dd.mm.yyyy hh:nn"); RuntimeError 6 when it has no calendar
// date.
void AppendByDatePicture(std::string& out,
                         DateTime date,
                         std::string_view picture,
                         const Region& region);

}  // namespace zebtell::base
