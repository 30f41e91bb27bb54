#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::base {

// Text is UTF-8 throughout. "Ignoring case" folds Latin, Greek and Cyrillic letters one to one,
// never to a letter of another length in bytes.

std::string_view Trimmed(std::string_view text);  // blanks only, at both ends
std::string Lower(std::string_view text);
std::string Upper(std::string_view text);
std::string LowerAscii(std::string_view text);
bool EqualNoCase(std::string_view a, std::string_view b);
bool StartsWithNoCase(std::string_view text, std::string_view start);
bool EndsWithNoCase(std::string_view text, std::string_view end);
// The position of `part` in `text` from `from` on, ignoring case; npos when it is not there.
std::size_t FindNoCase(std::string_view text, std::string_view part, std::size_t from = 0);
std::string Replaced(std::string_view text, std::string_view from, std::string_view to);
std::string ReplacedNoCase(std::string_view text, std::string_view from, std::string_view to);
// The parts between the marks: "a;;b" gives "a", "", "b"; empty text gives no part.
std::vector<std::string_view> Split(std::string_view text, char mark);

// A number as people type it, "." or "," as its mark, blanks around it ignored: "1,5", "-2", "1e3".
// Nothing for anything else, for two marks, and for what is beyond a double.
std::optional<double> ParseNumber(std::string_view text);

bool IsValidUtf8(std::string_view text);
// The text itself when it is UTF-8, else as windows-1257 (bytes without a meaning become U+FFFD).
std::string Utf8FromEither(std::string text);
// The characters (code points) of a text, and its first `count` of them.
std::size_t CharacterCount(std::string_view text);
std::string_view FirstCharacters(std::string_view text, std::size_t count);
// One code point as UTF-8.
void AppendUtf8(std::string& out, char32_t code_point);

// For one line of a log: line breaks and control characters become blanks.
std::string WithoutControls(std::string_view text);

// Dictionary keys that ignore (ASCII and other) case, with look-up by string_view.
struct NoCaseHash {
    using is_transparent = void;
    std::size_t operator()(std::string_view text) const;
};
struct NoCaseEqual {
    using is_transparent = void;
    bool operator()(std::string_view a, std::string_view b) const { return EqualNoCase(a, b); }
};

}  // namespace zebtell::base
