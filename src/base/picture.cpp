#include "base/picture.h"

#include <algorithm>
#include <optional>

#include "base/text.h"

namespace zebtell::base {

namespace {

constexpr std::string_view kDigitPlaces = "0#";
constexpr std::string_view kTextPlaces = "@&<>!";
constexpr std::string_view kDateLetters = "cdwmqyhnsCDWMQYHNS";

bool Holds(std::string_view characters, char c) {
    return characters.find(c) != std::string_view::npos;
}

// `rest` is what follows the character.
bool BeginsDateField(char c, std::string_view rest) {
    if (Holds(kDateLetters, c)) return true;
    if (c == 't' || c == 'T') return StartsWithNoCase(rest, "tttt");
    if (c != 'a' && c != 'A') return false;
    return StartsWithNoCase(rest, "m/pm") || StartsWithNoCase(rest, "mpm") ||
           StartsWithNoCase(rest, "/p");
}

std::optional<PictureKind> MeaningOf(char c, std::string_view rest) {
    if (Holds(kDigitPlaces, c)) return PictureKind::kNumber;
    if (Holds(kTextPlaces, c)) return PictureKind::kText;
    if (BeginsDateField(c, rest)) return PictureKind::kDate;
    return std::nullopt;
}

bool Suits(PictureKind kind, PictureSubject subject) {
    return (kind == PictureKind::kNumber && subject == PictureSubject::kNumber) ||
           (kind == PictureKind::kDate && subject == PictureSubject::kDate);
}

}  // namespace

bool PictureReader::Next(PictureElement& element) {
    if (rest_.empty()) return false;
    if (rest_[0] == '\\') {
        element = Literal(1, 2, 2);
    } else if (rest_[0] == '"') {
        const std::size_t end = std::min(rest_.find('"', 1), rest_.size());
        element = Literal(1, end, end + 1);
    } else {
        element = {rest_.substr(0, 1), false};
        rest_.remove_prefix(1);
    }
    return true;
}

PictureElement PictureReader::Literal(std::size_t start, std::size_t end, std::size_t next) {
    const PictureElement element{rest_.substr(start, end - start), true};
    rest_.remove_prefix(std::min(next, rest_.size()));
    return element;
}

PictureSections SectionsOf(std::string_view picture) {
    PictureSections sections;
    std::size_t start = 0;
    if (picture.find(';') != std::string_view::npos) {
        PictureReader reader(picture);
        for (PictureElement element; sections.count < 4 && reader.Next(element);) {
            if (element.literal || element.text[0] != ';') continue;
            const std::size_t mark = picture.size() - reader.rest().size() - 1;
            sections.parts[sections.count++] = picture.substr(start, mark - start);
            start = mark + 1;
        }
    }
    if (sections.count < 4) sections.parts[sections.count++] = picture.substr(start);
    return sections;
}

PictureKind KindOf(std::string_view picture, PictureSubject subject) {
    std::optional<PictureKind> first;
    PictureReader reader(picture);
    for (PictureElement element; reader.Next(element);) {
        if (element.literal) continue;
        const auto meaning = MeaningOf(element.text[0], reader.rest());
        if (!meaning) continue;
        if (!first) first = meaning;
        if (Suits(*meaning, subject) || subject == PictureSubject::kText) return *meaning;
    }
    return first.value_or(PictureKind::kNumber);
}

}  // namespace zebtell::base
