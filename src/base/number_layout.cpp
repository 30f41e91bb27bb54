#include "base/number_layout.h"

namespace zebtell::base {

namespace {

using Kind = NumberElement::Kind;

bool IsPlace(std::string_view text, std::size_t at) {
    return at < text.size() && (text[at] == '0' || text[at] == '#');
}

}  // namespace

bool NumberReader::Next(NumberElement& element) {
    PictureElement piece;
    if (!reader_.Next(piece)) return false;
    element = {Kind::kLiteral, piece.text};
    if (!piece.literal && !TakeExponent(element)) element.kind = KindOf(piece.text[0]);
    previous_ = element.kind;
    return true;
}

Kind NumberReader::KindOf(char c) {
    if (c == '%') return Kind::kPercent;
    if (after_exponent_) return Kind::kLiteral;
    if (c == '0' || c == '#') return after_mark_ ? Kind::kFraction : Kind::kInteger;
    if (c == ',' && IsFormatComma()) return Kind::kComma;
    if (c != '.' || after_mark_) return Kind::kLiteral;
    after_mark_ = true;
    return Kind::kMark;
}

// A comma that touches no place of the whole part is a comma of the text around the number.
bool NumberReader::IsFormatComma() const {
    const bool touches = previous_ == Kind::kInteger || previous_ == Kind::kComma;
    return !after_mark_ && (touches || IsPlace(reader_.rest(), 0));
}

// "E+00": the letter, the sign and the places, when all of them are there.
bool NumberReader::TakeExponent(NumberElement& element) {
    const char letter = element.text[0];
    const std::string_view rest = reader_.rest();
    if (after_exponent_ || (letter != 'E' && letter != 'e') || rest.empty()) return false;
    if ((rest[0] != '+' && rest[0] != '-') || !IsPlace(rest, 1)) return false;
    std::size_t size = 1;
    while (IsPlace(rest, size)) ++size;
    element = {Kind::kExponent, {element.text.data(), size + 1}};
    reader_.Skip(size);
    after_exponent_ = true;
    return true;
}

NumberLayout::NumberLayout(std::string_view section) {
    int commas = 0;  // since the last place of the whole part
    NumberReader reader(section);
    for (NumberElement element; reader.Next(element);) {
        const bool zero = element.text == "0";
        switch (element.kind) {
            case Kind::kInteger:
                groups = groups || (commas > 0 && integer_places > 0);
                commas = 0;
                ++integer_places;
                if (zero || integer_zeros > 0) ++integer_zeros;
                break;
            case Kind::kFraction:
                ++fraction_places;
                if (zero) fraction_zeros = fraction_places;
                break;
            case Kind::kMark:
                has_mark = true;
                break;
            case Kind::kComma:
                ++commas;
                break;
            case Kind::kPercent:
                shift += 2;
                break;
            case Kind::kExponent:
                scientific = true;
                break;
            case Kind::kLiteral:
                break;
        }
    }
    shift -= 3 * commas;
}

}  // namespace zebtell::base
