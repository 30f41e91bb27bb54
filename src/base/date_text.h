#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "base/date_time.h"
#include "base/region.h"

namespace zebtell::base {

// The digits of a number from 0 on, filled up with zeros to `width`.
void AppendPadded(std::string& out, int number, int width);

// "21.11.2026", in the region's order.
void AppendShortDate(std::string& out, const CalendarTime& time, const Region& region);
// "14:05:09".
void AppendLongTime(std::string& out, const CalendarTime& time, const Region& region);
// Date and time; without the time when that is zero, without the date when that is the zero date.
void AppendGeneralDate(std::string& out, const CalendarTime& time, const Region& region);

// A date in the region's order with ".", "/" or "-" between its parts, or with the year of four
// digits first; a time after it, or alone ("14:05", "2:05:09 PM"). Years of two digits are those
// from 1930 to 2029. Nothing for anything else.
std::optional<DateTime> ParseDate(std::string_view text, const Region& region);

}  // namespace zebtell::base
