#include "base/rounding.h"

#include <limits>

#include "base/decimal.h"
#include "base/runtime_error.h"

namespace zebtell::base {

namespace {

template <class Integer>
Integer Narrowed(double number) {
    const std::int64_t whole = ToInteger64(number);
    if (whole < std::numeric_limits<Integer>::min() ||
        whole > std::numeric_limits<Integer>::max()) {
        throw RuntimeError(errors::kOverflow);
    }
    return static_cast<Integer>(whole);
}

}  // namespace

double Rounded(double number, int decimals) {
    constexpr int kMostDecimals = 15;
    if (decimals < 0 || decimals > kMostDecimals) throw RuntimeError(errors::kInvalidCall);
    return Decimal::FromDouble(number).RoundedTo(decimals, Half::kToEven).ToDouble();
}

std::int16_t ToInteger16(double number) {
    return Narrowed<std::int16_t>(number);
}

std::int32_t ToInteger32(double number) {
    return Narrowed<std::int32_t>(number);
}

std::int64_t ToInteger64(double number) {
    // From 2^53 on a double is whole, and its shortest digits may be another whole number.
    constexpr double kWholeFrom = 9007199254740992.0;
    constexpr double kEnd = 9223372036854775808.0;  // 2^63
    if (number >= kWholeFrom || number <= -kWholeFrom) {
        if (number >= kEnd || number < -kEnd) throw RuntimeError(errors::kOverflow);
        return static_cast<std::int64_t>(number);
    }
    return Decimal::FromDouble(number).ToScaled(0);
}

}  // namespace zebtell::base
