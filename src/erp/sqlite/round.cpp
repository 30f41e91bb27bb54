#include "erp/sqlite/round.h"

#include <array>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <string>

namespace zebtell::erp::sqlite {
namespace {

constexpr std::array<double, 10> kPowers = {1, 1e1, 1e2, 1e3, 1e4, 1e5, 1e6, 1e7, 1e8, 1e9};
constexpr int kDigits = 15;

// On the digits themselves; for numbers at or near a half.
double RoundedDigits(double number, int decimals) {
    char text[40];  // "d.dddddddddddddde+xxx"
    std::snprintf(text, sizeof text, "%.*e", kDigits - 1, number);
    const int exponent = std::atoi(text + kDigits + 2);
    const int kept = exponent + 1 + decimals;
    if (kept >= kDigits) {
        return number;
    }
    if (kept < 0) {
        return 0;
    }
    std::string digits = std::string(1, text[0]) + std::string(text + 2, kDigits - 1);
    const bool up = digits[static_cast<std::size_t>(kept)] >= '5';
    digits.resize(static_cast<std::size_t>(kept));
    const double whole = (digits.empty() ? 0 : std::strtod(digits.c_str(), nullptr)) + (up ? 1 : 0);
    const std::string rounded =
        std::to_string(static_cast<long long>(whole)) + "e" + std::to_string(-decimals);
    return std::strtod(rounded.c_str(), nullptr);
}

}  // namespace

double RoundedHalfAway(double number, int decimals) {
    const double size = std::abs(number);
    if (!std::isfinite(number)) {
        return number;
    }
    if (decimals >= 0 && decimals < static_cast<int>(kPowers.size())) {
        const double power = kPowers[static_cast<std::size_t>(decimals)];
        const double scaled = size * power;
        const double whole = std::floor(scaled);
        // Far from a half, the binary number and its digits round alike.
        if (scaled < 1e9 && std::abs(scaled - whole - 0.5) > 1e-4) {
            return std::copysign((scaled - whole > 0.5 ? whole + 1 : whole) / power, number);
        }
    }
    return std::copysign(RoundedDigits(size, decimals), number);
}

}  // namespace zebtell::erp::sqlite
