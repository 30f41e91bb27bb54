#include "erp/odbc/utf16.h"

#include "base/text.h"
#include "base/unicode.h"

namespace zebtell::erp::odbc {
namespace {

constexpr char32_t kReplacement = 0xFFFD;
constexpr char32_t kFirstPair = 0x10000;
constexpr char32_t kLast = 0x10FFFF;

bool IsSurrogate(char32_t unit) {
    return unit >= 0xD800 && unit < 0xE000;
}

bool IsHigh(char32_t unit) {
    return unit >= 0xD800 && unit < 0xDC00;
}

bool IsLow(char32_t unit) {
    return unit >= 0xDC00 && unit < 0xE000;
}

}  // namespace

std::u16string ToUtf16(std::string_view text) {
    std::u16string result;
    result.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        const base::CodePoint point = base::DecodeAt(text, at);
        at += point.size;
        if (point.value >= kFirstPair && point.value <= kLast) {
            const char32_t offset = point.value - kFirstPair;
            result += static_cast<char16_t>(0xD800 + (offset >> 10));
            result += static_cast<char16_t>(0xDC00 + (offset & 0x3FF));
        } else {
            const bool known = point.value < kFirstPair && !IsSurrogate(point.value);
            result += static_cast<char16_t>(known ? point.value : kReplacement);
        }
    }
    return result;
}

std::string FromUtf16(std::u16string_view text) {
    std::string result;
    result.reserve(text.size());
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char32_t unit = text[at];
        if (unit < 0x80) {
            result += static_cast<char>(unit);
        } else if (!IsSurrogate(unit)) {
            base::AppendUtf8(result, unit);
        } else if (IsHigh(unit) && at + 1 < text.size() && IsLow(text[at + 1])) {
            const char32_t low = text[++at];
            base::AppendUtf8(result, kFirstPair + ((unit - 0xD800) << 10) + (low - 0xDC00));
        } else {
            base::AppendUtf8(result, kReplacement);
        }
    }
    return result;
}

}  // namespace zebtell::erp::odbc
