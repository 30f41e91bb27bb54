#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace zebtell::base {

__extension__ typedef unsigned __int128 Uint128;

// What becomes of a digit five with nothing behind it.
enum class Half { kToEven, kAwayFromZero };

// An exact decimal number: mantissa * 10^-scale (the scale may be negative), with its sign.
// Everything that rounds goes through RoundedTo.
struct Decimal {
    bool negative = false;
    Uint128 mantissa = 0;
    int scale = 0;

    // The shortest digits that give the number back; RuntimeError 6 for infinities and NaN.
    static Decimal FromDouble(double number);
    static Decimal FromInteger(std::int64_t number, int scale = 0);
    // "-12.5", "+3", ".5", "5.", "1e3"; nothing for anything else. Digits beyond the 36th count
    // only as "something more".
    static std::optional<Decimal> FromText(std::string_view text);

    // At most `decimals` places are left.
    Decimal RoundedTo(int decimals, Half half) const;
    // number * 10^decimals as a whole number, half to even; RuntimeError 6 when it does not fit.
    std::int64_t ToScaled(int decimals) const;
    double ToDouble() const;  // the nearest; RuntimeError 6 beyond a double
    bool IsZero() const { return mantissa == 0; }
    std::string Digits() const;  // of the mantissa, "" for zero
};

// Exact for factors of up to 19 digits each.
Decimal operator*(const Decimal& a, const Decimal& b);

}  // namespace zebtell::base
