#pragma once

#include <compare>
#include <optional>
#include <string>
#include <string_view>

namespace zebtell::base {

struct CalendarTime {
    int year = 1899;
    int month = 12;  // 1 to 12
    int day = 30;    // 1 to 31
    int hour = 0;
    int minute = 0;
    int second = 0;
};

// A local date with the time of day: days since 1899-12-30, the time as the fraction. The zero date
// is 0. Years 100 to 9999. Before the zero date the fraction still counts forward in time
// (-1.25 is 1899-12-29 06:00).
class DateTime {
  public:
    constexpr DateTime() = default;
    constexpr explicit DateTime(double days) : days_(days) {}
    // RuntimeError 5 when the fields are no date.
    static DateTime FromCalendar(const CalendarTime& fields);
    // Nothing when the fields are no date.
    static std::optional<DateTime> FromFields(const CalendarTime& fields);
    static DateTime Now();    // the server's local time, to the second
    static DateTime Today();  // with time 00:00:00
    // "2026-11-21", "2026-11-21 14:05:09", "2026-11-21T14:05:09"; nothing for anything else.
    static std::optional<DateTime> FromIso(std::string_view text);

    constexpr double days() const { return days_; }
    // Whether the days lie in those years. The functions below throw RuntimeError 6 when not.
    bool HasCalendar() const;
    CalendarTime Calendar() const;  // to the nearest second
    int Weekday() const;            // 1 = Sunday to 7 = Saturday
    DateTime DateOnly() const;
    bool HasTime() const;
    std::string ToIso() const;  // "2026-11-21" or, with a time, "2026-11-21 14:05:09"
    friend constexpr auto operator<=>(const DateTime&, const DateTime&) = default;

  private:
    double days_ = 0;
};

}  // namespace zebtell::base
