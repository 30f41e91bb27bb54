#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <variant>

#include "base/currency.h"
#include "base/date_time.h"
#include "base/region.h"

namespace zebtell::base {

// What a field holds and what a handler computes with.
class Value {
  public:
    enum class Kind { kEmpty, kNull, kBoolean, kInteger, kDouble, kCurrency, kDateTime, kText };

    Value() = default;  // empty
    static Value Null();
    Value(bool boolean) : data_(boolean) {}
    Value(int integer) : data_(static_cast<std::int64_t>(integer)) {}
    Value(std::int64_t integer) : data_(integer) {}
    Value(double number) : data_(number) {}
    Value(Currency amount) : data_(amount) {}
    Value(DateTime time) : data_(time) {}
    Value(std::string text) : data_(std::move(text)) {}
    Value(std::string_view text) : data_(std::string(text)) {}
    Value(const char* text) : data_(std::string(text)) {}

    Kind kind() const { return static_cast<Kind>(data_.index()); }
    bool IsEmpty() const { return kind() == Kind::kEmpty; }
    bool IsNull() const { return kind() == Kind::kNull; }
    // Empty, null or an empty text: nothing to show.
    bool IsBlank() const;
    // A number of any kind, a boolean, or text that reads as a number ("." or "," as its mark).
    bool IsNumeric() const;

    // Conversions. Null throws RuntimeError 94, what does not convert 13, what does not fit 6.
    // Empty is "", 0, false and the zero date. Text numbers are taken with "." or ",".
    std::string ToText(const Region& region) const;
    double ToDouble() const;
    std::int16_t ToInteger16() const;  // half to even
    std::int32_t ToInteger32() const;
    std::int64_t ToInteger64() const;
    Currency ToCurrency() const;
    // Numbers are days; text is a date in the region's order, or ISO.
    DateTime ToDateTime(const Region& region) const;
    bool ToBoolean() const;  // text: "true", "false" or a number
    // Text for SQL, logs and keys, the same in every region: "12.5", "2026-11-21", "" for null.
    std::string ToPlainText() const;

    // The text itself, without a copy; RuntimeError 13 when this is not text.
    const std::string& text() const;
    // For example to look at the alternative that kind() names.
    template <class T>
    const T* As() const {
        return std::get_if<T>(&data_);
    }

    friend bool operator==(const Value&, const Value&) = default;

  private:
    struct NullTag {
        friend bool operator==(NullTag, NullTag) = default;
    };
    std::variant<std::monostate,
                 NullTag,
                 bool,
                 std::int64_t,
                 double,
                 Currency,
                 DateTime,
                 std::string>
        data_;
};

}  // namespace zebtell::base
