#include "base/unicode.h"

#include <array>

namespace zebtell::base {

namespace {

// Capitals `first` to `last`, `step` apart; the small letter of each is `offset` further on.
struct CaseRange {
    char32_t first;
    char32_t last;
    int offset;
    int step;
};

constexpr CaseRange kCaseRanges[] = {
    {'A', 'Z', 32, 1},      {0xC0, 0xD6, 32, 1},    {0xD8, 0xDE, 32, 1},   {0x100, 0x12E, 1, 2},
    {0x132, 0x136, 1, 2},   {0x139, 0x147, 1, 2},   {0x14A, 0x176, 1, 2},  {0x178, 0x178, -121, 1},
    {0x179, 0x17D, 1, 2},   {0x18F, 0x18F, 202, 1}, {0x1A0, 0x1A0, 1, 1},  {0x1AF, 0x1AF, 1, 1},
    {0x1B7, 0x1B7, 219, 1}, {0x1CD, 0x1DB, 1, 2},   {0x1DE, 0x1EE, 1, 2},  {0x1F4, 0x1F4, 1, 1},
    {0x1F8, 0x21E, 1, 2},   {0x222, 0x232, 1, 2},   {0x386, 0x386, 38, 1}, {0x388, 0x38A, 37, 1},
    {0x38C, 0x38C, 64, 1},  {0x38E, 0x38F, 63, 1},  {0x391, 0x3A1, 32, 1}, {0x3A3, 0x3AB, 32, 1},
    {0x400, 0x40F, 80, 1},  {0x410, 0x42F, 32, 1},  {0x460, 0x480, 1, 2},  {0x48A, 0x4BE, 1, 2},
    {0x4C0, 0x4C0, 15, 1},  {0x4C1, 0x4CD, 1, 2},   {0x4D0, 0x52E, 1, 2},
};

// The first code point behind those ranges, and the one block of letters that lies further on.
constexpr char32_t kTableEnd = 0x530;
constexpr CaseRange kAdditional[] = {{0x1E00, 0x1E94, 1, 2}, {0x1EA0, 0x1EFE, 1, 2}};

using CaseTable = std::array<char16_t, kTableEnd>;

constexpr CaseTable MakeTable(bool to_lower) {
    CaseTable table{};
    for (char32_t c = 0; c < kTableEnd; ++c) table[c] = static_cast<char16_t>(c);
    for (const CaseRange& range : kCaseRanges) {
        for (char32_t c = range.first; c <= range.last; c += range.step) {
            const char32_t small = c + range.offset;
            table[to_lower ? c : small] = static_cast<char16_t>(to_lower ? small : c);
        }
    }
    return table;
}

constexpr CaseTable kLower = MakeTable(true);
constexpr CaseTable kUpper = MakeTable(false);

bool IsContinuation(std::string_view text, std::size_t at) {
    return at < text.size() && (static_cast<unsigned char>(text[at]) & 0xC0) == 0x80;
}

char32_t LowBits(std::string_view text, std::size_t at) {
    return static_cast<unsigned char>(text[at]) & 0x3F;
}

// Lone surrogates stand for bytes that are no character.
CodePoint LoneByte(unsigned char byte) {
    return {0xDC00U + byte, 1};
}

}  // namespace

CodePoint DecodeBeyondAscii(std::string_view text, std::size_t at) {
    const auto lead = static_cast<unsigned char>(text[at]);
    std::size_t size = 0;
    char32_t least = 0;
    char32_t value = 0;
    if ((lead & 0xE0) == 0xC0) {
        size = 2, least = 0x80, value = lead & 0x1FU;
    } else if ((lead & 0xF0) == 0xE0) {
        size = 3, least = 0x800, value = lead & 0x0FU;
    } else if ((lead & 0xF8) == 0xF0) {
        size = 4, least = 0x10000, value = lead & 0x07U;
    } else {
        return LoneByte(lead);
    }
    for (std::size_t i = 1; i < size; ++i) {
        if (!IsContinuation(text, at + i)) return LoneByte(lead);
        value = (value << 6) | LowBits(text, at + i);
    }
    const bool surrogate = value >= 0xD800 && value <= 0xDFFF;
    if (value < least || value > 0x10FFFF || surrogate) return LoneByte(lead);
    return {value, size};
}

char32_t LowerBeyondAscii(char32_t letter) {
    if (letter < kTableEnd) return kLower[letter];
    for (const CaseRange& range : kAdditional) {
        if (letter >= range.first && letter <= range.last) return letter | 1U;
    }
    return letter;
}

char32_t UpperLetter(char32_t letter) {
    if (letter < kTableEnd) return kUpper[letter];
    for (const CaseRange& range : kAdditional) {
        if (letter >= range.first && letter <= range.last + 1) return letter & ~char32_t{1};
    }
    return letter;
}

}  // namespace zebtell::base
