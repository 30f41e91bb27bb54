#include "http/http_date.h"

#include <array>
#include <charconv>
#include <cstdio>

namespace zebtell::http {
namespace {

constexpr std::array kDays = {"Sun", "Mon", "Tue", "Wed", "Thu", "Fri", "Sat"};
constexpr std::array kMonths = {
    "Jan", "Feb", "Mar", "Apr", "May", "Jun", "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};

std::optional<int> Number(std::string_view digits) {
    int number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    if (error != std::errc() || end != digits.data() + digits.size() || number < 0) return {};
    return number;
}

std::optional<int> Month(std::string_view name) {
    for (std::size_t i = 0; i < kMonths.size(); ++i) {
        if (name == kMonths[i]) return static_cast<int>(i);
    }
    return {};
}

}  // namespace

std::string FormatHttpDate(std::time_t time) {
    std::tm parts{};
    gmtime_r(&time, &parts);
    std::array<char, 64> text{};
    const int size = std::snprintf(text.data(),
                                   text.size(),
                                   "%s, %02d %s %04d %02d:%02d:%02d GMT",
                                   kDays[static_cast<std::size_t>(parts.tm_wday)],
                                   parts.tm_mday,
                                   kMonths[static_cast<std::size_t>(parts.tm_mon)],
                                   parts.tm_year + 1900,
                                   parts.tm_hour,
                                   parts.tm_min,
                                   parts.tm_sec);
    return {text.data(), static_cast<std::size_t>(size)};
}

std::optional<std::time_t> ParseHttpDate(std::string_view text) {
    constexpr std::string_view kShape = "???, ?? ??? ???? ??:??:?? GMT";
    if (text.size() != kShape.size()) return {};
    for (std::size_t i = 0; i < kShape.size(); ++i) {
        if (kShape[i] != '?' && kShape[i] != text[i]) return {};
    }
    const auto day = Number(text.substr(5, 2));
    const auto month = Month(text.substr(8, 3));
    const auto year = Number(text.substr(12, 4));
    const auto hour = Number(text.substr(17, 2));
    const auto minute = Number(text.substr(20, 2));
    const auto second = Number(text.substr(23, 2));
    if (!day || !month || !year || !hour || !minute || !second) return {};
    std::tm parts{};
    parts.tm_mday = *day;
    parts.tm_mon = *month;
    parts.tm_year = *year - 1900;
    parts.tm_hour = *hour;
    parts.tm_min = *minute;
    parts.tm_sec = *second;
    return timegm(&parts);
}

}  // namespace zebtell::http
