#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace zebtell::base {

// One code point of UTF-8 text and the bytes it takes.
struct CodePoint {
    char32_t value = 0;
    std::size_t size = 1;
};

// The code point that begins at `at` (which must lie in the text). A byte that begins none counts
// for itself, with a value that no character has.
CodePoint DecodeBeyondAscii(std::string_view text, std::size_t at);
inline CodePoint DecodeAt(std::string_view text, std::size_t at) {
    const auto lead = static_cast<unsigned char>(text[at]);
    return lead < 0x80 ? CodePoint{lead, 1} : DecodeBeyondAscii(text, at);
}

// Case of one letter. Only pairs that take equally many bytes in UTF-8 are known (Latin, Greek and
// Cyrillic letters), so that changing case never moves a position in a text.
char32_t LowerBeyondAscii(char32_t letter);
inline char32_t LowerLetter(char32_t letter) {
    if (letter >= 0x80) return LowerBeyondAscii(letter);
    return letter >= 'A' && letter <= 'Z' ? letter - 'A' + 'a' : letter;
}
char32_t UpperLetter(char32_t letter);

}  // namespace zebtell::base
