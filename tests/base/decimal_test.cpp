#include "base/decimal.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "base/currency.h"
#include "base/runtime_error.h"

namespace zebtell::base {
namespace {

__extension__ typedef __int128 Int128;

// Half to even on whole numbers, written apart from the code under test.
Int128 DividedHalfToEven(Int128 number, Int128 by) {
    Int128 quotient = number / by;
    const Int128 twice = (number % by) * 2;
    if (twice > by || (twice == by && quotient % 2 != 0)) ++quotient;
    if (-twice > by || (-twice == by && quotient % 2 != 0)) --quotient;
    return quotient;
}

TEST(DecimalTest, ProductsAgreeWithWholeNumberArithmetic) {
    constexpr int kRounds = 20000;
    constexpr Int128 kPowers[] = {1, 10, 100, 1000, 10000};
    std::mt19937_64 random(20261121);
    std::uniform_int_distribution<std::int64_t> prices(-50'000'000'000, 50'000'000'000);
    std::uniform_int_distribution<std::int64_t> thousandths(-9'999'999, 9'999'999);
    std::uniform_int_distribution<int> places(0, 4);
    for (int i = 0; i < kRounds; ++i) {
        const std::int64_t price = prices(random);
        const std::int64_t quantity = thousandths(random);
        const int decimals = places(random);
        const Int128 exact = static_cast<Int128>(price) * quantity;  // 10^-7
        const Int128 unit = kPowers[4 - decimals];
        const Int128 expected = DividedHalfToEven(exact, 1000 * unit) * unit;
        const Currency amount =
            Multiplied(Currency::FromScaled(price), static_cast<double>(quantity) / 1000, decimals);
        ASSERT_EQ(amount.scaled(), static_cast<std::int64_t>(expected))
            << price << " * " << quantity << " at " << decimals;
    }
}

TEST(DecimalTest, ShortestDigitsGiveEveryDoubleBack) {
    constexpr int kRounds = 20000;
    std::mt19937_64 random(7);
    std::uniform_real_distribution<double> mantissas(-1, 1);
    std::uniform_int_distribution<int> exponents(-1000, 1000);
    for (int i = 0; i < kRounds; ++i) {
        const double number = std::ldexp(mantissas(random), exponents(random));
        ASSERT_EQ(Decimal::FromDouble(number).ToDouble(), number);
    }
    constexpr double kGreatest = std::numeric_limits<double>::max();
    EXPECT_EQ(Decimal::FromDouble(kGreatest).ToDouble(), kGreatest);
    EXPECT_EQ(Decimal::FromDouble(-5e-324).ToDouble(), -5e-324);
}

TEST(DecimalTest, RoundsAtTheMiddleAsAsked) {
    struct Row {
        const char* number;
        int decimals;
        const char* to_even;
        const char* away;
    };
    const Row rows[] = {
        {"0.125", 2, "12", "13"},
        {"0.135", 2, "14", "14"},
        {"-2.5", 0, "2", "3"},
        {"0.5", 0, "", "1"},
        {"2.4999999999999999999999999999999999999999", 0, "2", "2"},
        {"2.5000000000000000000000000000000000000000000001", 0, "3", "3"},
        {"1e-50", 2, "", ""},
        {"0.05", 0, "", ""},
    };
    for (const Row& row : rows) {
        const auto number = Decimal::FromText(row.number);
        ASSERT_TRUE(number) << row.number;
        EXPECT_EQ(number->RoundedTo(row.decimals, Half::kToEven).Digits(), row.to_even)
            << row.number;
        EXPECT_EQ(number->RoundedTo(row.decimals, Half::kAwayFromZero).Digits(), row.away)
            << row.number;
    }
}

TEST(DecimalTest, ReadsOnlyNumbers) {
    for (const char* text : {"", "-", ".", "1.2.3", "1,5", " 1", "1 ", "0x1", "e3", "1e", "inf"}) {
        EXPECT_FALSE(Decimal::FromText(text)) << text;
    }
    EXPECT_EQ(Decimal::FromText("-.5")->ToDouble(), -0.5);
    EXPECT_EQ(Decimal::FromText("12e-1")->ToDouble(), 1.2);
    EXPECT_EQ(Decimal::FromText("1e-999999999999")->ToDouble(), 0);
    EXPECT_THROW(Decimal::FromText("1e999")->ToDouble(), RuntimeError);
    EXPECT_EQ(Decimal::FromText(std::string(5000, '9') + "e-4999")
                  ->RoundedTo(0, Half::kToEven)
                  .ToDouble(),
              10);
}

}  // namespace
}  // namespace zebtell::base
