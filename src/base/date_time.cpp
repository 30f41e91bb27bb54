#include "base/date_time.h"

#include <chrono>
#include <cmath>
#include <cstdio>
#include <ctime>

#include "base/runtime_error.h"

namespace zebtell::base {

namespace {

constexpr int kSecondsPerDay = 86400;
constexpr int kFirstDay = -657434;  // 0100-01-01
constexpr int kLastDay = 2958465;   // 9999-12-31
constexpr int kFirstYear = 100;
constexpr int kLastYear = 9999;
constexpr std::chrono::sys_days kZeroDate =
    std::chrono::year(1899) / std::chrono::December / std::chrono::day(30);

struct DayAndSecond {
    int day;
    int second;
};

// To the nearest second; nothing outside the years that a date may have.
std::optional<DayAndSecond> FindParts(double days) {
    if (!(days > kFirstDay - 1 && days < kLastDay + 1)) return std::nullopt;
    const double whole = std::trunc(days);
    DayAndSecond parts{static_cast<int>(whole),
                       static_cast<int>(std::lround(std::fabs(days - whole) * kSecondsPerDay))};
    if (parts.second == kSecondsPerDay) parts = {parts.day + 1, 0};
    if (parts.day > kLastDay) return std::nullopt;
    return parts;
}

DayAndSecond Parts(double days) {
    const auto parts = FindParts(days);
    if (!parts) throw RuntimeError(errors::kOverflow);
    return *parts;
}

bool IsTime(const CalendarTime& fields) {
    return fields.hour >= 0 && fields.hour < 24 && fields.minute >= 0 && fields.minute < 60 &&
           fields.second >= 0 && fields.second < 60;
}

double Joined(int day, int second) {
    const double fraction = static_cast<double>(second) / kSecondsPerDay;
    return day < 0 ? day - fraction : day + fraction;
}

std::optional<int> Digits(std::string_view text, std::size_t at, std::size_t count) {
    int number = 0;
    for (const char c : text.substr(at, count)) {
        if (c < '0' || c > '9') return std::nullopt;
        number = number * 10 + (c - '0');
    }
    return number;
}

std::optional<CalendarTime> IsoFields(std::string_view text) {
    constexpr std::size_t kDateSize = 10;
    constexpr std::size_t kFullSize = 19;
    if (text.size() != kDateSize && text.size() != kFullSize) return std::nullopt;
    if (text[4] != '-' || text[7] != '-') return std::nullopt;
    const auto year = Digits(text, 0, 4);
    const auto month = Digits(text, 5, 2);
    const auto day = Digits(text, 8, 2);
    if (!year || !month || !day) return std::nullopt;
    if (text.size() == kDateSize) return CalendarTime{*year, *month, *day, 0, 0, 0};
    if ((text[10] != ' ' && text[10] != 'T') || text[13] != ':' || text[16] != ':') {
        return std::nullopt;
    }
    const auto hour = Digits(text, 11, 2);
    const auto minute = Digits(text, 14, 2);
    const auto second = Digits(text, 17, 2);
    if (!hour || !minute || !second) return std::nullopt;
    return CalendarTime{*year, *month, *day, *hour, *minute, *second};
}

bool IsInRange(const CalendarTime& fields) {
    return fields.year >= kFirstYear && fields.year <= kLastYear && fields.month >= 1 &&
           fields.month <= 12 && fields.day >= 1 && fields.day <= 31 && IsTime(fields);
}

}  // namespace

std::optional<DateTime> DateTime::FromFields(const CalendarTime& fields) {
    // The calendar types keep small integers, so what is out of range must not reach them.
    if (!IsInRange(fields)) return std::nullopt;
    const std::chrono::year_month_day date{std::chrono::year(fields.year),
                                           std::chrono::month(static_cast<unsigned>(fields.month)),
                                           std::chrono::day(static_cast<unsigned>(fields.day))};
    if (!date.ok()) return std::nullopt;
    const int day = static_cast<int>((std::chrono::sys_days(date) - kZeroDate).count());
    return DateTime(Joined(day, fields.hour * 3600 + fields.minute * 60 + fields.second));
}

DateTime DateTime::FromCalendar(const CalendarTime& fields) {
    const auto result = FromFields(fields);
    if (!result) throw RuntimeError(errors::kInvalidCall);
    return *result;
}

DateTime DateTime::Now() {
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    const int second = local.tm_sec < 60 ? local.tm_sec : 59;  // a leap second
    return FromCalendar({local.tm_year + 1900,
                         local.tm_mon + 1,
                         local.tm_mday,
                         local.tm_hour,
                         local.tm_min,
                         second});
}

DateTime DateTime::Today() {
    return Now().DateOnly();
}

std::optional<DateTime> DateTime::FromIso(std::string_view text) {
    const auto fields = IsoFields(text);
    if (!fields) return std::nullopt;
    return FromFields(*fields);
}

bool DateTime::HasCalendar() const {
    return FindParts(days_).has_value();
}

CalendarTime DateTime::Calendar() const {
    const auto [day, second] = Parts(days_);
    const std::chrono::year_month_day date{kZeroDate + std::chrono::days(day)};
    return {static_cast<int>(date.year()),
            static_cast<int>(static_cast<unsigned>(date.month())),
            static_cast<int>(static_cast<unsigned>(date.day())),
            second / 3600,
            second / 60 % 60,
            second % 60};
}

int DateTime::Weekday() const {
    // The zero date was a Saturday. The shift keeps the sum positive.
    constexpr int kShift = 700000;
    static_assert(kShift % 7 == 0);
    return (Parts(days_).day + kShift + 6) % 7 + 1;
}

DateTime DateTime::DateOnly() const {
    return DateTime(Parts(days_).day);
}

bool DateTime::HasTime() const {
    return Parts(days_).second != 0;
}

std::string DateTime::ToIso() const {
    const CalendarTime c = Calendar();
    char buffer[64];
    int size = std::snprintf(buffer, sizeof buffer, "%04d-%02d-%02d", c.year, c.month, c.day);
    if (HasTime()) {
        size += std::snprintf(
            buffer + size, sizeof buffer - size, " %02d:%02d:%02d", c.hour, c.minute, c.second);
    }
    return {buffer, static_cast<std::size_t>(size)};
}

}  // namespace zebtell::base
