#pragma once

#include <compare>
#include <cstdint>
#include <string>
#include <string_view>

namespace zebtell::base {

// An amount of money: a 64-bit integer of ten-thousandths, so that sums are exact. Every operation
// that leaves its range throws RuntimeError 6.
class Currency {
  public:
    static constexpr int kDecimals = 4;
    static constexpr std::int64_t kScale = 10000;

    constexpr Currency() = default;
    static constexpr Currency FromScaled(std::int64_t ten_thousandths) {
        Currency result;
        result.scaled_ = ten_thousandths;
        return result;
    }
    // The nearest amount, half to even on the number's decimal digits (not on its binary value).
    static Currency FromDouble(double number);
    // A number written with "." as its mark and without groups; RuntimeError 13 for anything else.
    static Currency FromText(std::string_view text);

    constexpr std::int64_t scaled() const { return scaled_; }
    double ToDouble() const;
    // The shortest decimal text: "12.5", "-3", "0.0001", with the given decimal mark.
    std::string ToText(char decimal_mark = '.') const;

    // Half to even at `decimals` places, 0 to 4.
    Currency Rounded(int decimals) const;

    Currency operator-() const;
    Currency& operator+=(Currency other);
    Currency& operator-=(Currency other);
    friend Currency operator+(Currency a, Currency b) { return a += b; }
    friend Currency operator-(Currency a, Currency b) { return a -= b; }
    friend constexpr auto operator<=>(const Currency&, const Currency&) = default;

  private:
    std::int64_t scaled_ = 0;
};

// price * quantity, exact on decimal digits, then half to even at `decimals` places (0 to 4).
Currency Multiplied(Currency price, double quantity, int decimals);

// amount * percent / 100, exact on decimal digits, then half to even at `decimals` places.
Currency PercentOf(Currency amount, double percent, int decimals);

}  // namespace zebtell::base
