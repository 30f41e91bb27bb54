#include "base/decimal.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <limits>

#include "base/runtime_error.h"

namespace zebtell::base {

namespace {

constexpr int kMaxDigits = 38;   // of a 128-bit mantissa
constexpr int kReadDigits = 36;  // taken from text, one more is kept for "something more"
constexpr double kMaxExactDouble = 9007199254740992.0;  // 2^53
constexpr int kMaxExactPower = 22;

constexpr std::array<Uint128, kMaxDigits + 1> MakePowers() {
    std::array<Uint128, kMaxDigits + 1> powers{};
    powers[0] = 1;
    for (int i = 1; i <= kMaxDigits; ++i) powers[i] = powers[i - 1] * 10;
    return powers;
}

constexpr auto kPowers = MakePowers();

// Those powers that a double holds exactly.
constexpr std::array<double, kMaxExactPower + 1> MakeExactPowers() {
    std::array<double, kMaxExactPower + 1> powers{};
    for (int i = 0; i <= kMaxExactPower; ++i) powers[i] = static_cast<double>(kPowers[i]);
    return powers;
}

constexpr auto kExactPowers = MakeExactPowers();

struct Division {
    Uint128 quotient;
    Uint128 remainder;
};

// 128-bit division is a slow call; nearly every number fits 64 bits.
Division Divided(Uint128 number, Uint128 by) {
    if ((number >> 64) == 0 && (by >> 64) == 0) {
        const auto n = static_cast<std::uint64_t>(number);
        const auto d = static_cast<std::uint64_t>(by);
        return {n / d, n % d};
    }
    return {number / by, number % by};
}

// Numbers of at most four decimals and fifteen digits, such as prices: when n / 10^4 gives the
// double back, no other decimal as short does.
std::optional<Decimal> FromShortDouble(double number) {
    constexpr double kLimit = 1e11;
    constexpr double kTenThousand = 10000.0;
    if (!(std::fabs(number) < kLimit)) return std::nullopt;
    const double scaled = std::nearbyint(number * kTenThousand);
    if (scaled / kTenThousand != number) return std::nullopt;
    return Decimal::FromInteger(static_cast<std::int64_t>(scaled), 4);
}

// Reads the parts of a number's text one after the other.
class Reader {
  public:
    explicit Reader(std::string_view text) : rest_(text) {}

    std::optional<Decimal> Read() {
        result_.negative = ReadSign();
        ReadDigits(false);
        if (Take('.')) ReadDigits(true);
        if (!any_digit_) return std::nullopt;
        if ((Take('e') || Take('E')) && !ReadExponent()) return std::nullopt;
        if (!rest_.empty()) return std::nullopt;
        if (lost_) {
            result_.mantissa = result_.mantissa * 10 + 1;
            ++result_.scale;
        }
        return result_;
    }

  private:
    bool Take(char wanted) {
        if (rest_.empty() || rest_.front() != wanted) return false;
        rest_.remove_prefix(1);
        return true;
    }

    bool ReadSign() {
        if (Take('-')) return true;
        Take('+');
        return false;
    }

    std::optional<int> TakeDigit() {
        if (rest_.empty() || rest_.front() < '0' || rest_.front() > '9') return std::nullopt;
        const int digit = rest_.front() - '0';
        rest_.remove_prefix(1);
        return digit;
    }

    void ReadDigits(bool fraction) {
        while (const auto digit = TakeDigit()) {
            any_digit_ = true;
            if (result_.mantissa < kPowers[kReadDigits]) {
                result_.mantissa = result_.mantissa * 10 + static_cast<unsigned>(*digit);
                result_.scale += fraction ? 1 : 0;
            } else {
                lost_ = lost_ || *digit != 0;
                result_.scale -= fraction ? 0 : 1;
            }
        }
    }

    bool ReadExponent() {
        constexpr int kEnough = 100000;
        const bool negative = ReadSign();
        int exponent = 0;
        bool any = false;
        while (const auto digit = TakeDigit()) {
            any = true;
            exponent = std::min(exponent * 10 + *digit, kEnough);
        }
        result_.scale += negative ? exponent : -exponent;
        return any;
    }

    std::string_view rest_;
    Decimal result_;
    bool any_digit_ = false;
    bool lost_ = false;
};

}  // namespace

Decimal Decimal::FromDouble(double number) {
    if (!std::isfinite(number)) throw RuntimeError(errors::kOverflow);
    if (const auto short_number = FromShortDouble(number)) return *short_number;
    char buffer[32];
    // In scientific notation, as the plain one may carry digits beyond the shortest.
    constexpr auto kFormat = std::chars_format::scientific;
    const auto end = std::to_chars(buffer, buffer + sizeof buffer, number, kFormat).ptr;
    return Reader({buffer, static_cast<std::size_t>(end - buffer)}).Read().value();
}

Decimal Decimal::FromInteger(std::int64_t number, int scale) {
    const auto bits = static_cast<std::uint64_t>(number);
    return {number < 0, number < 0 ? 0 - bits : bits, scale};
}

std::optional<Decimal> Decimal::FromText(std::string_view text) {
    return Reader(text).Read();
}

Decimal Decimal::RoundedTo(int decimals, Half half) const {
    const int dropped = scale - decimals;
    if (dropped <= 0) return *this;
    if (dropped > kMaxDigits) return {negative, 0, decimals};
    const Uint128 power = kPowers[dropped];
    auto [quotient, remainder] = Divided(mantissa, power);
    const Uint128 middle = power / 2;
    const bool up_at_middle = half == Half::kAwayFromZero || (quotient & 1) != 0;
    if (remainder > middle || (remainder == middle && up_at_middle)) ++quotient;
    return {negative, quotient, decimals};
}

std::int64_t Decimal::ToScaled(int decimals) const {
    const Decimal rounded = RoundedTo(decimals, Half::kToEven);
    if (rounded.IsZero()) return 0;
    constexpr Uint128 kMost = std::numeric_limits<std::int64_t>::max();
    const Uint128 most = kMost + (negative ? 1 : 0);
    const int missing = decimals - rounded.scale;
    if (missing > kMaxDigits || rounded.mantissa > most / kPowers[missing]) {
        throw RuntimeError(errors::kOverflow);
    }
    const auto bits = static_cast<std::uint64_t>(rounded.mantissa * kPowers[missing]);
    return static_cast<std::int64_t>(negative ? 0 - bits : bits);
}

double Decimal::ToDouble() const {
    const double sign = negative ? -1.0 : 1.0;
    // Both exact, so that their quotient is the nearest double.
    if (mantissa <= static_cast<Uint128>(kMaxExactDouble) && scale >= 0 &&
        scale <= kMaxExactPower) {
        return sign * static_cast<double>(static_cast<std::uint64_t>(mantissa)) /
               kExactPowers[scale];
    }
    if (IsZero()) return 0;
    const std::string text = Digits() + "e" + std::to_string(-scale);
    double result = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), result);
    if (error == std::errc::result_out_of_range) {
        if (static_cast<int>(text.size()) - scale < 0) return 0;
        throw RuntimeError(errors::kOverflow);
    }
    return sign * result;
}

std::string Decimal::Digits() const {
    constexpr std::uint64_t kHalf = 10'000'000'000'000'000'000U;  // 10^19
    if (IsZero()) return "";
    const auto [high, low] = Divided(mantissa, kHalf);
    if (high == 0) return std::to_string(static_cast<std::uint64_t>(low));
    const std::string low_digits = std::to_string(static_cast<std::uint64_t>(low));
    return std::to_string(static_cast<std::uint64_t>(high)) +
           std::string(19 - low_digits.size(), '0') + low_digits;
}

Decimal operator*(const Decimal& a, const Decimal& b) {
    return {a.negative != b.negative, a.mantissa * b.mantissa, a.scale + b.scale};
}

}  // namespace zebtell::base
