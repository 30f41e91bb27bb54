#include "base/date_time.h"

#include <gtest/gtest.h>

#include <cmath>

#include "base/date_text.h"
#include "base/runtime_error.h"

namespace zebtell::base {
namespace {

TEST(DateTimeTest, CountsDaysFromTheZeroDate) {
    struct Row {
        const char* iso;
        double days;
        int weekday;
    };
    const Row rows[] = {
        {"1899-12-30", 0, 7},
        {"1899-12-31", 1, 1},
        {"1899-12-29 06:00:00", -1.25, 6},
        {"1900-03-01", 61, 5},
        {"2000-02-29", 36585, 3},
        {"2026-11-21 12:00:00", 46347.5, 7},
        {"0100-01-01", -657434, 6},
        {"9999-12-31", 2958465, 6},
    };
    for (const Row& row : rows) {
        const auto time = DateTime::FromIso(row.iso);
        ASSERT_TRUE(time) << row.iso;
        EXPECT_EQ(time->days(), row.days) << row.iso;
        EXPECT_EQ(time->ToIso(), row.iso);
        EXPECT_EQ(time->Weekday(), row.weekday) << row.iso;
    }
}

TEST(DateTimeTest, EverySecondOfADayComesBack) {
    for (int second = 0; second < 86400; second += 7) {
        const CalendarTime time{2026, 11, 21, second / 3600, second / 60 % 60, second % 60};
        const CalendarTime back = DateTime::FromCalendar(time).Calendar();
        ASSERT_EQ(back.hour * 3600 + back.minute * 60 + back.second, second);
        ASSERT_EQ(back.day, 21);
    }
}

TEST(DateTimeTest, RoundsToTheNearestSecond) {
    const DateTime late(46347 + 86399.7 / 86400);
    EXPECT_EQ(late.ToIso(), "2026-11-22");
    EXPECT_EQ(late.DateOnly().days(), 46348);
    EXPECT_FALSE(late.HasTime());
    EXPECT_EQ(DateTime(46347.5).DateOnly().days(), 46347);
}

TEST(DateTimeTest, RefusesWhatIsNoDate) {
    const CalendarTime wrong[] = {{2026, 2, 29, 0, 0, 0},
                                  {2026, 13, 1, 0, 0, 0},
                                  {2026, 257, 1, 0, 0, 0},
                                  {2026, 1, 0, 0, 0, 0},
                                  {99, 1, 1, 0, 0, 0},
                                  {10000, 1, 1, 0, 0, 0},
                                  {67562, 1, 1, 0, 0, 0},
                                  {2026, 1, 1, 24, 0, 0},
                                  {2026, 1, 1, 0, -1, 0}};
    for (const CalendarTime& fields : wrong) {
        EXPECT_THROW(DateTime::FromCalendar(fields), RuntimeError) << fields.month;
    }
    for (const double days : {1e300, -1e9, 2958465.99999999, std::nan("")}) {
        EXPECT_FALSE(DateTime(days).HasCalendar()) << days;
        EXPECT_THROW(DateTime(days).Calendar(), RuntimeError) << days;
        EXPECT_THROW(DateTime(days).Weekday(), RuntimeError) << days;
    }
    for (const char* text : {"",
                             "2026-11-2",
                             "2026-1-121",
                             "2026/11/21",
                             "2026-02-30",
                             "2026-11-21 ",
                             "2026-11-21 14:05",
                             "2026-11-21x14:05:09",
                             "2026-11-21 24:00:00",
                             "+026-11-21"}) {
        EXPECT_FALSE(DateTime::FromIso(text)) << text;
    }
}

TEST(DateTextTest, ReadsDatesInTheRegionsOrder) {
    struct Row {
        const char* region;
        const char* text;
        const char* expected;  // "" when it is no date
    };
    const Row rows[] = {
        {"et", "21.11.2026", "2026-11-21"},
        {"et", " 1.2.2026 ", "2026-02-01"},
        {"et", "1/2/26", "2026-02-01"},
        {"et", "1-2-75", "1975-02-01"},
        {"en", "21/11/2026 2:05 PM", "2026-11-21 14:05:00"},
        {"en", "21/11/2026  12:05:09 am", "2026-11-21 00:05:09"},
        {"et", "2026-11-21T14:05:09", "2026-11-21 14:05:09"},
        {"et", "2026-11-21 9:05", "2026-11-21 09:05:00"},
        {"lv", "14:05:09", "1899-12-30 14:05:09"},
        {"et", "11.21.2026", ""},
        {"et", "31.4.2026", ""},
        {"et", "21.11", ""},
        {"et", "21.11/2026", ""},
        {"et", "21.11.20261", ""},
        {"et", "21.11.126", ""},
        {"et", "21.11.2026x", ""},
        {"et", "21.11.2026 25:00", ""},
        {"et", "13:00 PM", ""},
        {"et", "14:5", ""},
        {"et", "14", ""},
        {"et", "", ""},
    };
    for (const Row& row : rows) {
        const auto date = ParseDate(row.text, RegionFor(row.region));
        EXPECT_EQ(date ? date->ToIso() : "", row.expected) << row.text;
    }
}

TEST(DateTextTest, ReadsTheOtherOrders) {
    Region region = RegionFor("en");
    region.date_order = DateOrder::kMonthDayYear;
    EXPECT_EQ(ParseDate("11/21/2026", region)->ToIso(), "2026-11-21");
    std::string text;
    AppendShortDate(text, {2026, 11, 2, 0, 0, 0}, region);
    EXPECT_EQ(text, "11/02/2026");
    region.date_order = DateOrder::kYearMonthDay;
    EXPECT_EQ(ParseDate("26/11/21", region)->ToIso(), "2026-11-21");
}

}  // namespace
}  // namespace zebtell::base
