#include "base/text.h"

#include <algorithm>
#include <array>
#include <charconv>

#include "base/unicode.h"

namespace zebtell::base {

namespace {

constexpr std::array<char, 256> MakeLowerBytes() {
    std::array<char, 256> bytes{};
    for (int i = 0; i < 256; ++i) {
        bytes[i] = static_cast<char>(i >= 'A' && i <= 'Z' ? i - 'A' + 'a' : i);
    }
    return bytes;
}

// Small ASCII letters; bytes of other characters stay.
constexpr auto kLowerBytes = MakeLowerBytes();

bool IsAscii(char byte) {
    return static_cast<unsigned char>(byte) < 0x80;
}

char LowerByte(char byte) {
    return kLowerBytes[static_cast<unsigned char>(byte)];
}

bool IsContinuation(char byte) {
    return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

template <class Change>
std::string WithLetters(std::string_view text, Change change) {
    std::string result;
    result.reserve(text.size());
    for (std::size_t i = 0; i < text.size();) {
        const CodePoint letter = DecodeAt(text, i);
        const char32_t changed = change(letter.value);
        if (changed == letter.value) {
            result += text.substr(i, letter.size);
        } else {
            AppendUtf8(result, changed);
        }
        i += letter.size;
    }
    return result;
}

// `find` gives the position of the next place, as std::string_view::find does.
template <class Find>
std::string ReplacedWhere(std::string_view text,
                          std::string_view from,
                          std::string_view to,
                          Find find) {
    if (from.empty()) return std::string(text);
    std::string result;
    result.reserve(text.size());
    std::size_t done = 0;
    for (std::size_t at = find(text, from, 0); at != std::string_view::npos;
         at = find(text, from, done)) {
        result += text.substr(done, at - done);
        result += to;
        done = at + from.size();
    }
    result += text.substr(done);
    return result;
}

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

std::size_t SkipDigits(std::string_view text, std::size_t at) {
    while (at < text.size() && IsDigit(text[at])) ++at;
    return at;
}

bool IsSign(std::string_view text, std::size_t at) {
    return at < text.size() && (text[at] == '+' || text[at] == '-');
}

// Where an exponent that begins at `at` ends; `at` itself when there is none.
std::size_t SkipExponent(std::string_view text, std::size_t at) {
    if (at >= text.size() || LowerByte(text[at]) != 'e') return at;
    const std::size_t digits = at + 1 + (IsSign(text, at + 1) ? 1 : 0);
    const std::size_t end = SkipDigits(text, digits);
    return end == digits ? at : end;
}

// Whether the text is a number; `mark` becomes the position of its decimal mark, if any.
bool IsNumber(std::string_view text, std::size_t& mark) {
    const std::size_t start = IsSign(text, 0) ? 1 : 0;
    std::size_t at = SkipDigits(text, start);
    std::size_t digits = at - start;
    mark = std::string_view::npos;
    if (at < text.size() && (text[at] == '.' || text[at] == ',')) {
        mark = at;
        const std::size_t fraction = at + 1;
        at = SkipDigits(text, fraction);
        digits += at - fraction;
    }
    return digits > 0 && SkipExponent(text, at) == text.size();
}

}  // namespace

std::string_view Trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(' ');
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(' ') - first + 1);
}

std::string Lower(std::string_view text) {
    return WithLetters(text, LowerLetter);
}

std::string Upper(std::string_view text) {
    return WithLetters(text, UpperLetter);
}

std::string LowerAscii(std::string_view text) {
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), LowerByte);
    return result;
}

bool EqualNoCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size();) {
        if (IsAscii(a[i]) || IsAscii(b[i])) {
            if (LowerByte(a[i]) != LowerByte(b[i])) return false;
            ++i;
            continue;
        }
        const CodePoint left = DecodeAt(a, i);
        const CodePoint right = DecodeAt(b, i);
        if (LowerLetter(left.value) != LowerLetter(right.value)) return false;
        i += left.size;
    }
    return true;
}

bool StartsWithNoCase(std::string_view text, std::string_view start) {
    return text.size() >= start.size() && EqualNoCase(text.substr(0, start.size()), start);
}

bool EndsWithNoCase(std::string_view text, std::string_view end) {
    return text.size() >= end.size() && EqualNoCase(text.substr(text.size() - end.size()), end);
}

std::size_t FindNoCase(std::string_view text, std::string_view part, std::size_t from) {
    if (from > text.size()) return std::string_view::npos;
    if (part.empty()) return from;
    const bool ascii = IsAscii(part[0]);
    const char first = LowerByte(part[0]);
    for (std::size_t at = from; at + part.size() <= text.size(); ++at) {
        const bool candidate =
            ascii ? LowerByte(text[at]) == first : !IsAscii(text[at]) && !IsContinuation(text[at]);
        if (candidate && EqualNoCase(text.substr(at, part.size()), part)) return at;
    }
    return std::string_view::npos;
}

std::string Replaced(std::string_view text, std::string_view from, std::string_view to) {
    return ReplacedWhere(
        text, from, to, [](std::string_view whole, std::string_view part, std::size_t at) {
            return whole.find(part, at);
        });
}

std::string ReplacedNoCase(std::string_view text, std::string_view from, std::string_view to) {
    return ReplacedWhere(text, from, to, FindNoCase);
}

std::vector<std::string_view> Split(std::string_view text, char mark) {
    std::vector<std::string_view> parts;
    if (text.empty()) return parts;
    std::size_t start = 0;
    for (std::size_t at = text.find(mark); at != std::string_view::npos;
         at = text.find(mark, start)) {
        parts.push_back(text.substr(start, at - start));
        start = at + 1;
    }
    parts.push_back(text.substr(start));
    return parts;
}

std::optional<double> ParseNumber(std::string_view text) {
    text = Trimmed(text);
    std::size_t mark = 0;
    if (!IsNumber(text, mark)) return std::nullopt;
    if (text[0] == '+') {
        text.remove_prefix(1);
        if (mark != std::string_view::npos) --mark;
    }
    std::string plain(text);
    if (mark != std::string_view::npos) plain[mark] = '.';
    double number = 0;
    const auto result = std::from_chars(plain.data(), plain.data() + plain.size(), number);
    if (result.ec != std::errc()) return std::nullopt;
    return number;
}

std::size_t CharacterCount(std::string_view text) {
    return text.size() - std::count_if(text.begin(), text.end(), IsContinuation);
}

std::string_view FirstCharacters(std::string_view text, std::size_t count) {
    if (count >= text.size()) return text;
    std::size_t at = 0;
    for (; at < text.size(); ++at) {
        if (!IsContinuation(text[at]) && count-- == 0) break;
    }
    return text.substr(0, at);
}

std::string WithoutControls(std::string_view text) {
    std::string result;
    result.reserve(text.size());
    for (std::size_t i = 0; i < text.size();) {
        const CodePoint c = DecodeAt(text, i);
        const bool line_break = c.value == 0x2028 || c.value == 0x2029;
        const bool control = c.value < 0x20 || (c.value >= 0x7F && c.value < 0xA0);
        if (line_break || control) {
            result += ' ';
        } else {
            result += text.substr(i, c.size);
        }
        i += c.size;
    }
    return result;
}

std::size_t NoCaseHash::operator()(std::string_view text) const {
    constexpr std::uint64_t kPrime = 0x100000001B3U;
    std::uint64_t hash = 0xCBF29CE484222325U;
    for (std::size_t i = 0; i < text.size();) {
        if (IsAscii(text[i])) {
            hash = (hash ^ static_cast<unsigned char>(LowerByte(text[i]))) * kPrime;
            ++i;
            continue;
        }
        const CodePoint letter = DecodeAt(text, i);
        hash = (hash ^ LowerLetter(letter.value)) * kPrime;
        i += letter.size;
    }
    return hash;
}

}  // namespace zebtell::base
