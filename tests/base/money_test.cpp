#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "base/currency.h"
#include "base/rounding.h"
#include "base/runtime_error.h"

namespace zebtell::base {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr std::int64_t kMost = std::numeric_limits<std::int64_t>::max();
constexpr std::int64_t kLeast = std::numeric_limits<std::int64_t>::min();

// The number of the RuntimeError that the work ends with, 0 when it ends well.
template <class Work>
int ErrorOf(Work work) {
    try {
        work();
    } catch (const RuntimeError& error) {
        return error.number();
    }
    return 0;
}

TEST(RoundingTest, LooksAtTheWrittenDigits) {
    struct Row {
        double number;
        int decimals;
        double expected;
    };
    const Row rows[] = {
        {2.675, 2, 2.68},  // below the middle in binary
        {1.005, 2, 1.0},   // the middle, to even
        {0.125, 2, 0.12},  //
        {0.375, 2, 0.38},  //
        {-2.5, 0, -2},     //
        {1234.5678, 4, 1234.5678},
        {0.1 + 0.2, 15, 0.3},
        {1e300, 2, 1e300},
        {5e-324, 15, 0},
    };
    for (const Row& row : rows) {
        EXPECT_EQ(Rounded(row.number, row.decimals), row.expected) << row.number;
    }
    EXPECT_EQ(ErrorOf([] { Rounded(kInfinity, 2); }), 6);
    EXPECT_EQ(ErrorOf([] { Rounded(std::nan(""), 2); }), 6);
    EXPECT_EQ(ErrorOf([] { Rounded(1, -1); }), 5);
}

TEST(RoundingTest, WholeNumbersEndAtTheirRange) {
    EXPECT_EQ(ToInteger16(32767.5 - 1), 32766);
    EXPECT_EQ(ToInteger16(-32768.4), -32768);
    EXPECT_EQ(ErrorOf([] { ToInteger16(32767.5); }), 6);
    EXPECT_EQ(ToInteger32(2.5), 2);
    EXPECT_EQ(ToInteger32(3.5), 4);
    EXPECT_EQ(ErrorOf([] { ToInteger32(2147483648.0); }), 6);
    EXPECT_EQ(ToInteger64(-9223372036854775808.0), kLeast);
    EXPECT_EQ(ErrorOf([] { ToInteger64(9223372036854775808.0); }), 6);
    EXPECT_EQ(ErrorOf([] { ToInteger64(-kInfinity); }), 6);
}

TEST(CurrencyTest, TakesTheNearestAmount) {
    struct Row {
        double number;
        std::int64_t scaled;
    };
    const Row rows[] = {
        {12.5, 125000},
        {0.00005, 0},
        {0.00015, 2},
        {-0.00025, -2},
        {0.1 + 0.2, 3000},
        {922337203685477.0, 9223372036854770000},
    };
    for (const Row& row : rows) {
        EXPECT_EQ(Currency::FromDouble(row.number).scaled(), row.scaled) << row.number;
    }
    EXPECT_EQ(ErrorOf([] { Currency::FromDouble(1e308); }), 6);
    EXPECT_EQ(ErrorOf([] { Currency::FromDouble(std::nan("")); }), 6);
}

TEST(CurrencyTest, TextKeepsEveryDigit) {
    struct Row {
        const char* text;
        std::int64_t scaled;
        const char* written;
    };
    const Row rows[] = {
        {"922337203685477.5807", kMost, "922337203685477.5807"},
        {"-922337203685477.5808", kLeast, "-922337203685477.5808"},
        {"-0.05", -500, "-0.05"},
        {"12.50", 125000, "12.5"},
        {"1e2", 1000000, "100"},
        {"0.00005", 0, "0"},
        {"0.000050000000000000000000000000000000000000000001", 1, "0.0001"},
    };
    for (const Row& row : rows) {
        const Currency amount = Currency::FromText(row.text);
        EXPECT_EQ(amount.scaled(), row.scaled) << row.text;
        EXPECT_EQ(amount.ToText(), row.written);
    }
    EXPECT_EQ(Currency::FromScaled(-12500).ToText(','), "-1,25");
    EXPECT_EQ(ErrorOf([] { Currency::FromText("1,5"); }), 13);
    EXPECT_EQ(ErrorOf([] { Currency::FromText(""); }), 13);
    EXPECT_EQ(ErrorOf([] { Currency::FromText("922337203685477.5808"); }), 6);
}

TEST(CurrencyTest, RoundsToEven) {
    struct Row {
        std::int64_t scaled;
        int decimals;
        std::int64_t expected;
    };
    const Row rows[] = {
        {12350, 2, 12400},
        {12450, 2, 12400},
        {-12450, 2, -12400},
        {12451, 2, 12500},
        {25000, 0, 20000},
        {12345, 4, 12345},
    };
    for (const Row& row : rows) {
        EXPECT_EQ(Currency::FromScaled(row.scaled).Rounded(row.decimals).scaled(), row.expected)
            << row.scaled;
    }
    EXPECT_EQ(ErrorOf([] { Currency::FromScaled(kMost).Rounded(0); }), 6);
    EXPECT_EQ(ErrorOf([] { Currency::FromScaled(1).Rounded(5); }), 5);
}

TEST(CurrencyTest, PercentagesDoNotMissTheCent) {
    struct Row {
        std::int64_t amount;
        double percent;
        int decimals;
        std::int64_t expected;
    };
    const Row rows[] = {
        {1005000, 20, 2, 201000},   // 100.50
        {11500, 15, 2, 1700},       // 0.1725
        {10500, 10, 2, 1000},       // 0.105, to even
        {299900, 22, 2, 66000},     // 6.5978
        {299900, -7.5, 2, -22500},  // -2.24925
        {10000, 0.005, 4, 0},       // 0.00005, to even
    };
    for (const Row& row : rows) {
        EXPECT_EQ(PercentOf(Currency::FromScaled(row.amount), row.percent, row.decimals).scaled(),
                  row.expected)
            << row.amount << " " << row.percent;
    }
}

TEST(CurrencyTest, NothingLeavesTheRangeUnseen) {
    const Currency most = Currency::FromScaled(kMost);
    const Currency least = Currency::FromScaled(kLeast);
    const Currency smallest = Currency::FromScaled(1);
    EXPECT_EQ(ErrorOf([&] { return most + smallest; }), 6);
    EXPECT_EQ(ErrorOf([&] { return least - smallest; }), 6);
    EXPECT_EQ(ErrorOf([&] { return -least; }), 6);
    EXPECT_EQ(ErrorOf([&] { return Multiplied(most, 1.5, 2); }), 6);
    EXPECT_EQ(ErrorOf([&] { return Multiplied(most, 1e308, 2); }), 6);
    EXPECT_EQ(ErrorOf([&] { return Multiplied(smallest, kInfinity, 2); }), 6);
    EXPECT_EQ(Multiplied(most, 1e-300, 2).scaled(), 0);
    EXPECT_EQ(Multiplied(most, 1, 4).scaled(), kMost);
    Currency sum = most;
    EXPECT_EQ(ErrorOf([&] { sum += smallest; }), 6);
    EXPECT_EQ(sum.scaled(), kMost);
}

}  // namespace
}  // namespace zebtell::base
