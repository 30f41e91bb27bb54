#pragma once

#include <array>
#include <string>
#include <string_view>

namespace zebtell::base {

enum class DateOrder { kDayMonthYear, kMonthDayYear, kYearMonthDay };

// How numbers and dates are written for people. Numbers in SQL never use it.
struct Region {
    std::string name;  // "et", "lv", "en"
    char decimal_mark = '.';
    char group_mark = ',';
    char date_mark = '/';
    char time_mark = ':';
    DateOrder date_order = DateOrder::kDayMonthYear;
    std::string currency_picture;   // the named format "Currency" as a number picture
    std::string long_date_picture;  // the named format "Long Date" as a date picture
    std::array<std::string, 12> months;
    std::array<std::string, 12> short_months;
    std::array<std::string, 7> days;  // from Sunday
    std::array<std::string, 7> short_days;
    std::string yes, no, true_text, false_text, on, off, am, pm;
};

// The region of a name or of a language setting, by its first two letters without regard to case:
// "EN", "LV", anything else Estonian. The result lives as long as the process.
const Region& RegionFor(std::string_view name);

}  // namespace zebtell::base
