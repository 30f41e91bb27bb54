#include "base/value.h"

#include <gtest/gtest.h>

#include <limits>

#include "base/runtime_error.h"

namespace zebtell::base {
namespace {

const Region& Estonian() {
    return RegionFor("ET");
}
const Region& English() {
    return RegionFor("english");
}

template <class Work>
int ErrorOf(Work work) {
    try {
        work();
    } catch (const RuntimeError& error) {
        return error.number();
    }
    return 0;
}

TEST(ValueTest, TextForPeopleAndForMachines) {
    struct Row {
        Value value;
        const char* estonian;
        const char* english;
        const char* plain;
    };
    const Row rows[] = {
        {Value(), "", "", ""},
        {true, "True", "True", "1"},
        {false, "False", "False", "0"},
        {-17, "-17", "-17", "-17"},
        {12.5, "12,5", "12.5", "12.5"},
        {0.1 + 0.2, "0,3", "0.3", "0.30000000000000004"},
        {-0.0, "0", "0", "0"},
        {1e15, "1E+15", "1E+15", "1e+15"},
        {123456789012345.0, "123456789012345", "123456789012345", "123456789012345"},
        {1.5e20, "1,5E+20", "1.5E+20", "1.5e+20"},
        {0.0001, "0,0001", "0.0001", "0.0001"},
        {1e-7, "1E-07", "1E-07", "1e-07"},
        {Currency::FromScaled(-12500), "-1,25", "-1.25", "-1.25"},
        {DateTime(46347), "21.11.2026", "21/11/2026", "2026-11-21"},
        {DateTime(46347.5), "21.11.2026 12:00:00", "21/11/2026 12:00:00", "2026-11-21 12:00:00"},
        {DateTime(0.25), "06:00:00", "06:00:00", "1899-12-30 06:00:00"},
        {DateTime(), "00:00:00", "00:00:00", "1899-12-30"},
        {" õun ", " õun ", " õun ", " õun "},
    };
    for (const Row& row : rows) {
        EXPECT_EQ(row.value.ToText(Estonian()), row.estonian);
        EXPECT_EQ(row.value.ToText(English()), row.english);
        EXPECT_EQ(row.value.ToPlainText(), row.plain);
    }
    EXPECT_EQ(ErrorOf([] { return Value::Null().ToText(Estonian()); }), 94);
    EXPECT_EQ(Value::Null().ToPlainText(), "");
    const Value infinite(std::numeric_limits<double>::infinity());
    EXPECT_EQ(ErrorOf([&] { return infinite.ToText(Estonian()); }), 6);
    EXPECT_EQ(ErrorOf([&] { return infinite.ToPlainText(); }), 6);
}

TEST(ValueTest, Numbers) {
    EXPECT_EQ(Value(" 1,5 ").ToDouble(), 1.5);
    EXPECT_EQ(Value("2.5").ToInteger32(), 2);
    EXPECT_EQ(Value("3,5").ToInteger16(), 4);
    EXPECT_EQ(Value("9007199254740993").ToInteger64(), 9007199254740993);
    EXPECT_EQ(Value(Currency::FromScaled(25000)).ToInteger32(), 2);
    EXPECT_EQ(Value(DateTime(1.5)).ToDouble(), 1.5);
    EXPECT_EQ(Value().ToInteger32(), 0);
    EXPECT_EQ(Value(true).ToDouble(), 1);
    EXPECT_EQ(Value(" 922337203685477,5807 ").ToCurrency().scaled(), 9223372036854775807);
    EXPECT_EQ(Value(12.34565).ToCurrency().scaled(), 123456);
    EXPECT_EQ(Value(7).ToCurrency().scaled(), 70000);

    EXPECT_EQ(ErrorOf([] { return Value("1,5,5").ToDouble(); }), 13);
    EXPECT_EQ(ErrorOf([] { return Value("").ToInteger32(); }), 13);
    EXPECT_EQ(ErrorOf([] { return Value("abc").ToCurrency(); }), 13);
    EXPECT_EQ(ErrorOf([] { return Value("1,5.5").ToCurrency(); }), 13);
    EXPECT_EQ(ErrorOf([] { return Value(32768).ToInteger16(); }), 6);
    EXPECT_EQ(ErrorOf([] { return Value(3000000000.0).ToInteger32(); }), 6);
    EXPECT_EQ(ErrorOf([] { return Value(1e300).ToCurrency(); }), 6);
    EXPECT_EQ(ErrorOf([] { return Value::Null().ToInteger32(); }), 94);
    EXPECT_EQ(ErrorOf([] { return Value::Null().ToCurrency(); }), 94);
}

TEST(ValueTest, DatesAndBooleans) {
    EXPECT_EQ(Value("2.1.2026").ToDateTime(Estonian()).ToIso(), "2026-01-02");
    EXPECT_EQ(Value("2026-01-02").ToDateTime(English()).ToIso(), "2026-01-02");
    EXPECT_EQ(Value(46347).ToDateTime(English()).ToIso(), "2026-11-21");
    EXPECT_EQ(Value("46347").ToDateTime(English()).ToIso(), "2026-11-21");
    EXPECT_EQ(Value().ToDateTime(English()), DateTime());
    EXPECT_EQ(ErrorOf([] { return Value("homme").ToDateTime(Estonian()); }), 13);
    EXPECT_EQ(ErrorOf([] { return Value::Null().ToDateTime(Estonian()); }), 94);

    EXPECT_TRUE(Value(" TRUE ").ToBoolean());
    EXPECT_FALSE(Value("false").ToBoolean());
    EXPECT_TRUE(Value("0,5").ToBoolean());
    EXPECT_FALSE(Value().ToBoolean());
    EXPECT_EQ(ErrorOf([] { return Value("yes").ToBoolean(); }), 13);
    EXPECT_EQ(ErrorOf([] { return Value::Null().ToBoolean(); }), 94);
}

TEST(ValueTest, WhatIsBlankOrNumeric) {
    struct Row {
        Value value;
        bool blank;
        bool numeric;
    };
    const Row rows[] = {
        {Value(), true, false},
        {Value::Null(), true, false},
        {"", true, false},
        {" ", false, false},
        {"1,5", false, true},
        {"1 234", false, false},
        {0, false, true},
        {false, false, true},
        {Currency(), false, true},
        {DateTime(), false, false},
    };
    for (const Row& row : rows) {
        EXPECT_EQ(row.value.IsBlank(), row.blank) << row.value.ToPlainText();
        EXPECT_EQ(row.value.IsNumeric(), row.numeric) << row.value.ToPlainText();
    }
    EXPECT_NE(Value(), Value::Null());
    EXPECT_NE(Value(1), Value(1.0));
    EXPECT_EQ(ErrorOf([] { return Value(1).text(); }), 13);
}

TEST(RegionTest, IsChosenByTwoLetters) {
    EXPECT_EQ(RegionFor("LV-lv").months[2], "Marts");
    EXPECT_EQ(RegionFor("en").days[0], "Sunday");
    EXPECT_EQ(RegionFor("").months[2], "Märts");
    EXPECT_EQ(RegionFor("E").name, "et");
    EXPECT_EQ(RegionFor("ru").name, "et");
}

TEST(RuntimeErrorTest, KeepsItsNumber) {
    EXPECT_EQ(RuntimeError(errors::kTypeMismatch).description(), "Type mismatch");
    EXPECT_EQ(RuntimeError(4711).description(), "Error 4711");
    const RuntimeError failed(errors::kStatementFailed, "near \"selec\"");
    EXPECT_EQ(AsRuntimeError(failed).number(), -2147217900);
    EXPECT_EQ(AsRuntimeError(failed).description(), "near \"selec\"");
    const std::out_of_range other("somewhere else");
    EXPECT_EQ(AsRuntimeError(other).number(), -2147467259);
    EXPECT_EQ(AsRuntimeError(other).description(), "somewhere else");
}

}  // namespace
}  // namespace zebtell::base
