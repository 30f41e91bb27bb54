#include "base/currency.h"

#include <cstdlib>

#include "base/decimal.h"
#include "base/runtime_error.h"

namespace zebtell::base {

namespace {

Decimal AsDecimal(Currency amount) {
    return Decimal::FromInteger(amount.scaled(), Currency::kDecimals);
}

Currency RoundedAmount(const Decimal& exact, int decimals) {
    if (decimals < 0 || decimals > Currency::kDecimals) throw RuntimeError(errors::kInvalidCall);
    const Decimal rounded = exact.RoundedTo(decimals, Half::kToEven);
    return Currency::FromScaled(rounded.ToScaled(Currency::kDecimals));
}

}  // namespace

Currency Currency::FromDouble(double number) {
    return FromScaled(Decimal::FromDouble(number).ToScaled(kDecimals));
}

Currency Currency::FromText(std::string_view text) {
    const auto number = Decimal::FromText(text);
    if (!number) throw RuntimeError(errors::kTypeMismatch);
    return FromScaled(number->ToScaled(kDecimals));
}

double Currency::ToDouble() const {
    return AsDecimal(*this).ToDouble();
}

std::string Currency::ToText(char decimal_mark) const {
    const std::int64_t whole = scaled_ / kScale;
    std::int64_t rest = std::abs(scaled_ % kScale);
    std::string text = scaled_ < 0 && whole == 0 ? "-0" : std::to_string(whole);
    if (rest == 0) return text;
    text += decimal_mark;
    for (std::int64_t place = kScale / 10; rest != 0; place /= 10) {
        text += static_cast<char>('0' + rest / place);
        rest %= place;
    }
    return text;
}

Currency Currency::Rounded(int decimals) const {
    return RoundedAmount(AsDecimal(*this), decimals);
}

Currency Currency::operator-() const {
    return Currency() -= *this;
}

Currency& Currency::operator+=(Currency other) {
    std::int64_t result = 0;
    if (__builtin_add_overflow(scaled_, other.scaled_, &result)) {
        throw RuntimeError(errors::kOverflow);
    }
    scaled_ = result;
    return *this;
}

Currency& Currency::operator-=(Currency other) {
    std::int64_t result = 0;
    if (__builtin_sub_overflow(scaled_, other.scaled_, &result)) {
        throw RuntimeError(errors::kOverflow);
    }
    scaled_ = result;
    return *this;
}

Currency Multiplied(Currency price, double quantity, int decimals) {
    return RoundedAmount(AsDecimal(price) * Decimal::FromDouble(quantity), decimals);
}

Currency PercentOf(Currency amount, double percent, int decimals) {
    constexpr int kHundredth = 2;
    Decimal share = AsDecimal(amount) * Decimal::FromDouble(percent);
    share.scale += kHundredth;
    return RoundedAmount(share, decimals);
}

}  // namespace zebtell::base
