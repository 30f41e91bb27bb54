#pragma once

#include <string_view>

#include "base/picture.h"

namespace zebtell::base {

struct NumberElement {
    enum class Kind { kLiteral, kInteger, kFraction, kMark, kComma, kPercent, kExponent };
    Kind kind = Kind::kLiteral;
    std::string_view text;
};

// Reads one section of a number picture.
class NumberReader {
  public:
    explicit NumberReader(std::string_view section) : reader_(section) {}
    bool Next(NumberElement& element);

  private:
    NumberElement::Kind KindOf(char c);
    bool IsFormatComma() const;
    bool TakeExponent(NumberElement& element);

    PictureReader reader_;
    NumberElement::Kind previous_ = NumberElement::Kind::kLiteral;
    bool after_mark_ = false;
    bool after_exponent_ = false;
};

// What a section asks of the number as a whole.
struct NumberLayout {
    explicit NumberLayout(std::string_view section);

    // Whether the section shows digits at all.
    bool ShowsNumber() const { return integer_places > 0 || has_mark; }

    int integer_places = 0;
    int integer_zeros = 0;  // places from the first "0" on
    int fraction_places = 0;
    int fraction_zeros = 0;  // places up to the last "0"
    int shift = 0;           // powers of ten that the number is multiplied by
    bool has_mark = false;
    bool groups = false;
    bool scientific = false;
};

}  // namespace zebtell::base
