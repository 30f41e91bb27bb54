#include <gtest/gtest.h>

#include "base/format.h"

namespace zebtell::base {
namespace {

struct Row {
    Value value;
    const char* picture;
    const char* expected;
};

template <std::size_t kSize>
void ExpectEach(const Row (&rows)[kSize], const Region& region) {
    for (const Row& row : rows) {
        EXPECT_EQ(Format(row.value, row.picture, region), row.expected)
            << row.value.ToPlainText() << " by " << row.picture;
    }
}

const DateTime kMorning = DateTime::FromCalendar({2026, 3, 5, 9, 7, 2});
const DateTime kEvening = DateTime::FromCalendar({2026, 11, 21, 14, 5, 9});

TEST(FormatDateTest, Fields) {
    const Row rows[] = {
        {kMorning, "d dd ddd dddd", "5 05 N Neljapäev"},
        {kMorning, "m mm mmm mmmm", "3 03 märts Märts"},
        {kMorning, "y yy yyyy", "64 26 2026"},
        {kMorning, "yyy", "2664"},
        {kMorning, "h hh n nn s ss", "9 09 7 07 2 02"},
        {kMorning, "q w ww", "1 5 10"},
        {kEvening, "q w ww", "4 7 47"},
        {kMorning, "ddddd ttttt", "05.03.2026 09:07:02"},
        {kMorning, "dddddd", "5. Märts 2026"},
        {kEvening, "c", "21.11.2026 14:05:09"},
        {kEvening, "ddddddd", "21. November 202621"},
        {kEvening, "DD.MM.YYYY HH:NN:SS", "21.11.2026 14:05:09"},
        {DateTime::FromCalendar({2026, 1, 3, 0, 0, 0}), "ww", "1"},
        {DateTime::FromCalendar({2026, 1, 4, 0, 0, 0}), "ww", "2"},
        {DateTime::FromCalendar({2028, 12, 31, 0, 0, 0}), "y ww", "366 54"},
    };
    ExpectEach(rows, RegionFor("et"));
}

TEST(FormatDateTest, MinutesFollowHours) {
    const Row rows[] = {
        {kEvening, "hh:mm", "14:05"},
        {kEvening, "h \"tundi\" m", "14 tundi 5"},
        {kEvening, "hh:mm mm", "14:05 11"},
        {kEvening, "hh:nn m", "14:05 11"},
        {kEvening, "mm/dd hh.mm", "11.21 14.05"},
    };
    ExpectEach(rows, RegionFor("et"));
}

TEST(FormatDateTest, HalvesOfTheDay) {
    const DateTime midnight = DateTime::FromCalendar({2026, 1, 1, 0, 30, 0});
    const DateTime noon = DateTime::FromCalendar({2026, 1, 1, 12, 0, 0});
    const Row rows[] = {
        {kEvening, "h:nn AM/PM", "2:05 PM"},
        {kMorning, "hh:nn am/pm", "09:07 am"},
        {kEvening, "AMPM h", "PL 2"},
        {kEvening, "h a/p", "2 p"},
        {kMorning, "h A/P", "9 A"},
        {midnight, "h:nn AM/PM", "12:30 AM"},
        {noon, "h:nn AM/PM", "12:00 PM"},
        {kEvening, "h \"AM/PM\"", "14 AM/PM"},
        {kEvening, "h aa", "14 aa"},
    };
    ExpectEach(rows, RegionFor("et"));
}

TEST(FormatDateTest, SeparatorsAndLiterals) {
    const Row english[] = {
        {kEvening, "dd/mm/yyyy", "21/11/2026"},
        {kEvening, "dd.mm.yyyy", "21.11.2026"},
        {kEvening, "\\#mm\\/dd\\/yyyy\\#", "#11/21/2026#"},
        {kEvening, "d \"d\" \\d", "21 d d"},
        {kEvening, "#mm/dd/yyyy#", "#11/21/2026#"},
    };
    ExpectEach(english, RegionFor("en"));
    const Row estonian[] = {
        {kEvening, "dd/mm/yyyy", "21.11.2026"},
        {kEvening, "\\#mm\\/dd\\/yyyy\\#", "#11/21/2026#"},
        {kEvening, "d õ mm", "21 õ 11"},
    };
    ExpectEach(estonian, RegionFor("et"));
}

TEST(FormatDateTest, NamedFormats) {
    const Row rows[] = {
        {kEvening, "General Date", "21/11/2026 14:05:09"},
        {DateTime(46347), "general date", "21/11/2026"},
        {DateTime(0.25), "General Date", "06:00:00"},
        {kEvening, "Long Date", "21 November 2026"},
        {kEvening, "Medium Date", "21-Nov-26"},
        {kEvening, "Short Date", "21/11/2026"},
        {kEvening, "Long Time", "14:05:09"},
        {kEvening, "Medium Time", "02:05 PM"},
        {kEvening, "Short Time", "14:05"},
        {kEvening, "Fixed", "46347.59"},
    };
    ExpectEach(rows, RegionFor("en"));
    EXPECT_EQ(Format(kEvening, "Long Date", RegionFor("lv")), "2026. gada 21. Novembris");
}

TEST(FormatDateTest, NumbersAndTextAreDatesWhenTheyCanBe) {
    const Row rows[] = {
        {46347, "dd.mm.yyyy", "21.11.2026"},
        {"21.11.2026", "yyyy", "2026"},
        {"2026-11-21 14:05:09", "hh:mm", "14:05"},
        {"46347", "Short Date", "21.11.2026"},
        {"homme", "dd.mm.yyyy", "homme"},
        {"", "dd.mm.yyyy", ""},
        {"homme", "Short Date", "homme"},
        {1e10, "dd.mm.yyyy", "10000000000"},
        {Value(), "dd.mm.yyyy", "30.12.1899"},
        {Value::Null(), "dd.mm.yyyy", ""},
    };
    ExpectEach(rows, RegionFor("et"));
}

TEST(FormatTextTest, PlacesAreFilledFromTheRight) {
    const Row rows[] = {
        {"ab", "@@@@", "  ab"},
        {"ab", "!@@@@", "ab  "},
        {"ab", "&&&&", "ab"},
        {"ab", "[&&@@@]", "[ ab]"},
        {"abcdef", "@-@", "a-bcdef"},
        {"õäü", "@@@@", " õäü"},
        {"5551234", "@@@-@@@@", "555-1234"},
        {"Õun", ">", "ÕUN"},
        {"ÕUN", "<", "õun"},
        {"Õun", ">@@@@", " ÕUN"},
        {"ab", "\\@@\"&\"@", "@a&b"},
        {"ab", "@;\"none\"", "ab"},
        {"", "@;\"none\"", "none"},
        {"", "@@", "  "},
        {12.5, "@@@@@@", "  12,5"},
        {kEvening, "&", "21.11.2026 14:05:09"},
        {Value::Null(), "@@", ""},
    };
    ExpectEach(rows, RegionFor("et"));
}

}  // namespace
}  // namespace zebtell::base
