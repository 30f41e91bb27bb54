#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "base/date_time.h"
#include "base/region.h"
#include "host/session_state.h"

namespace zebtell::catalogue {

// Entries of HTML selection lists; the template has the select element around them. Texts from the
// database are HTML-escaped.

// "All", favourites, then the categories of `group` ("" for every group), the chosen one
// preselected.
std::string CategoryOptions(host::SessionState& state, std::string_view group);

// One entry a record: its ID and the named field.
std::string RecordOptions(data::RecordList& list,
                          std::string_view field,
                          std::int64_t selected,
                          const base::Region& region);

std::string DayOptions(base::DateTime date);
// Names of the months in the user's language, whatever the region for numbers and dates is.
std::string MonthOptions(base::DateTime date, host::UserLanguage language);
// From ten years back to `today`'s year.
std::string YearOptions(base::DateTime date, base::DateTime today);

}  // namespace zebtell::catalogue
