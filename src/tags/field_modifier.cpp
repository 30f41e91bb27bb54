#include "tags/field_modifier.h"

#include <charconv>
#include <cstdint>
#include <optional>

#include "base/format.h"
#include "base/rounding.h"
#include "base/text.h"

namespace zebtell::tags {

namespace {

constexpr std::string_view kDateWord = "zebdate";
constexpr std::string_view kDateEnd = ";zebdate";
constexpr std::string_view kTextStart = "zeb:";
constexpr std::string_view kLength = "len=";
constexpr std::string_view kAttribute = "attr";

bool IsText(std::string_view modifier) {
    return base::StartsWithNoCase(modifier, kTextStart);
}

bool IsDate(std::string_view modifier) {
    return base::EqualNoCase(modifier, kDateWord) || base::EndsWithNoCase(modifier, kDateEnd);
}

bool Holds(std::string_view modifier, std::string_view word) {
    return base::FindNoCase(modifier, word) != std::string_view::npos;
}

std::string DateText(const base::Value& value,
                     std::string_view modifier,
                     const base::Region& region) {
    std::string_view picture;
    if (modifier.size() > kDateEnd.size()) {
        picture = modifier.substr(0, modifier.size() - kDateEnd.size());
    }
    if (base::ToInteger32(value.ToDateTime(region).days()) == 0) return {};
    return base::Format(value, picture, region);
}

// The number that "20,quote" begins with; none when there is none or it is too large.
std::optional<std::size_t> LeadingNumber(std::string_view text) {
    const std::string_view digits = base::Trimmed(text);
    std::int16_t number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    if (error != std::errc() || number < 0) return std::nullopt;
    return static_cast<std::size_t>(number);
}

// "..." takes three of the characters, so that a column keeps its width.
void CutTo(std::optional<std::size_t> length, std::string& text) {
    constexpr std::size_t kDots = 3;
    if (!length || *length <= kDots) return;
    const std::size_t kept = *length - kDots;
    if (text.size() <= kept || base::CharacterCount(text) <= kept) return;
    text.resize(base::FirstCharacters(text, kept).size());
    text += "...";
}

std::string WithQuotesEscaped(std::string_view text) {
    std::string escaped = base::Replaced(text, "\"", "&quot;");
    escaped = base::Replaced(escaped, "'", "&acute;");
    escaped = base::Replaced(escaped, "\r\n", " ");
    return std::string(base::Trimmed(escaped));
}

std::string TextByWords(const base::Value& value,
                        std::string_view modifier,
                        const base::Region& region) {
    std::string text(base::Trimmed(value.ToText(region)));
    if (const std::size_t at = base::FindNoCase(modifier, kLength); at != std::string_view::npos) {
        CutTo(LeadingNumber(modifier.substr(at + kLength.size())), text);
    }
    // An attribute's text is escaped whole, and once.
    if (Holds(modifier, "quote") && !Holds(modifier, kAttribute)) text = WithQuotesEscaped(text);
    return text;
}

}  // namespace

std::string ModifiedText(const base::Value& value,
                         std::string_view modifier,
                         const base::Region& region) {
    if (IsDate(modifier)) return DateText(value, modifier, region);
    if (IsText(modifier)) return TextByWords(value, modifier, region);
    return base::Format(value, modifier, region);
}

bool NeedsValue(std::string_view modifier) {
    return IsDate(modifier) || IsText(modifier);
}

Ending EndingOf(std::string_view modifier) {
    if (!IsText(modifier) || IsDate(modifier)) return Ending::kShown;
    if (Holds(modifier, kAttribute)) return Ending::kAttribute;
    return Holds(modifier, "nospace") ? Ending::kKeptEmpty : Ending::kShown;
}

}  // namespace zebtell::tags
