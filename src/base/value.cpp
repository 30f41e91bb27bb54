#include "base/value.h"

#include <charconv>
#include <cmath>
#include <optional>

#include "base/date_text.h"
#include "base/decimal.h"
#include "base/rounding.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::base {

namespace {

template <class... Cases>
struct Overloaded : Cases... {
    using Cases::operator()...;
};
template <class... Cases>
Overloaded(Cases...) -> Overloaded<Cases...>;

[[noreturn]] void ThrowMismatch() {
    throw RuntimeError(errors::kTypeMismatch);
}

// The same number as an amount, when its shortest digits are at most 15 with at most 4 decimals:
// amounts are written several times faster.
std::optional<Currency> ShortAmount(double number) {
    constexpr std::int64_t kEnd = 1'000'000'000'000'000;
    const Decimal decimal = Decimal::FromDouble(number);
    if (decimal.scale != Currency::kDecimals || decimal.mantissa >= kEnd) return std::nullopt;
    const auto digits = static_cast<std::int64_t>(decimal.mantissa);
    return Currency::FromScaled(decimal.negative ? -digits : digits);
}

// As people read numbers: at most 15 digits, "1E+20" from there on.
std::string GeneralNumber(double number, char decimal_mark) {
    constexpr int kDigits = 15;
    if (const auto amount = ShortAmount(number)) return amount->ToText(decimal_mark);
    char buffer[40];
    const auto end =
        std::to_chars(buffer, buffer + sizeof buffer, number, std::chars_format::general, kDigits)
            .ptr;
    std::string text(buffer, end);
    for (char& c : text) {
        if (c == '.') c = decimal_mark;
        if (c == 'e') c = 'E';
    }
    return text;
}

// All digits, so that a database gets the same number.
std::string ShortestNumber(double number) {
    if (!std::isfinite(number)) throw RuntimeError(errors::kOverflow);
    if (number == 0) return "0";
    // Where the plain notation is short, it is what people expect in a log or a key.
    const double size = std::fabs(number);
    char buffer[40];
    char* const last = buffer + sizeof buffer;
    const auto end = size >= 1e-5 && size < 1e15
                         ? std::to_chars(buffer, last, number, std::chars_format::fixed).ptr
                         : std::to_chars(buffer, last, number).ptr;
    return {buffer, end};
}

std::string GeneralDate(DateTime time, const Region& region) {
    std::string text;
    AppendGeneralDate(text, time.Calendar(), region);
    return text;
}

double NumberIn(const std::string& text) {
    const auto number = ParseNumber(text);
    if (!number) ThrowMismatch();
    return *number;
}

Currency AmountIn(const std::string& text) {
    return Currency::FromText(Replaced(Trimmed(text), ",", "."));
}

// Without the way over a double, which would lose digits of long numbers.
std::int64_t WholeNumberIn(const std::string& text) {
    const auto number = Decimal::FromText(Replaced(Trimmed(text), ",", "."));
    if (!number) ThrowMismatch();
    return number->ToScaled(0);
}

DateTime DateIn(const std::string& text, const Region& region) {
    if (const auto date = ParseDate(text, region)) return *date;
    return DateTime(NumberIn(text));
}

bool BooleanIn(const std::string& text) {
    const std::string_view word = Trimmed(text);
    if (EqualNoCase(word, "true")) return true;
    if (EqualNoCase(word, "false")) return false;
    return NumberIn(text) != 0;
}

}  // namespace

Value Value::Null() {
    Value result;
    result.data_ = NullTag{};
    return result;
}

bool Value::IsBlank() const {
    const auto* own = As<std::string>();
    return IsEmpty() || IsNull() || (own != nullptr && own->empty());
}

bool Value::IsNumeric() const {
    if (const auto* own = As<std::string>()) return ParseNumber(*own).has_value();
    return kind() == Kind::kBoolean || kind() == Kind::kInteger || kind() == Kind::kDouble ||
           kind() == Kind::kCurrency;
}

std::string Value::ToText(const Region& region) const {
    return std::visit(Overloaded{
                          [](std::monostate) { return std::string(); },
                          [](NullTag) -> std::string { throw RuntimeError(errors::kInvalidNull); },
                          [](bool boolean) { return std::string(boolean ? "True" : "False"); },
                          [](std::int64_t integer) { return std::to_string(integer); },
                          [&](double number) { return GeneralNumber(number, region.decimal_mark); },
                          [&](Currency amount) { return amount.ToText(region.decimal_mark); },
                          [&](DateTime time) { return GeneralDate(time, region); },
                          [](const std::string& text) { return text; },
                      },
                      data_);
}

double Value::ToDouble() const {
    return std::visit(Overloaded{
                          [](std::monostate) { return 0.0; },
                          [](NullTag) -> double { throw RuntimeError(errors::kInvalidNull); },
                          [](bool boolean) { return boolean ? 1.0 : 0.0; },
                          [](std::int64_t integer) { return static_cast<double>(integer); },
                          [](double number) { return number; },
                          [](Currency amount) { return amount.ToDouble(); },
                          [](DateTime time) { return time.days(); },
                          [](const std::string& text) { return NumberIn(text); },
                      },
                      data_);
}

std::int16_t Value::ToInteger16() const {
    return base::ToInteger16(static_cast<double>(ToInteger64()));
}

std::int32_t Value::ToInteger32() const {
    return base::ToInteger32(static_cast<double>(ToInteger64()));
}

std::int64_t Value::ToInteger64() const {
    if (const auto* integer = As<std::int64_t>()) return *integer;
    if (const auto* amount = As<Currency>()) {
        return Decimal::FromInteger(amount->scaled(), Currency::kDecimals).ToScaled(0);
    }
    if (const auto* own = As<std::string>()) return WholeNumberIn(*own);
    return base::ToInteger64(ToDouble());
}

Currency Value::ToCurrency() const {
    if (const auto* amount = As<Currency>()) return *amount;
    if (const auto* own = As<std::string>()) return AmountIn(*own);
    if (const auto* integer = As<std::int64_t>()) {
        return Currency::FromScaled(Decimal::FromInteger(*integer).ToScaled(Currency::kDecimals));
    }
    return Currency::FromDouble(ToDouble());
}

DateTime Value::ToDateTime(const Region& region) const {
    if (const auto* time = As<DateTime>()) return *time;
    if (const auto* own = As<std::string>()) return DateIn(*own, region);
    return DateTime(ToDouble());
}

bool Value::ToBoolean() const {
    if (const auto* own = As<std::string>()) return BooleanIn(*own);
    return ToDouble() != 0;
}

std::string Value::ToPlainText() const {
    return std::visit(Overloaded{
                          [](std::monostate) { return std::string(); },
                          [](NullTag) { return std::string(); },
                          [](bool boolean) { return std::string(boolean ? "1" : "0"); },
                          [](std::int64_t integer) { return std::to_string(integer); },
                          [](double number) { return ShortestNumber(number); },
                          [](Currency amount) { return amount.ToText(); },
                          [](DateTime time) { return time.ToIso(); },
                          [](const std::string& text) { return text; },
                      },
                      data_);
}

const std::string& Value::text() const {
    const auto* own = As<std::string>();
    if (own == nullptr) ThrowMismatch();
    return *own;
}

}  // namespace zebtell::base
