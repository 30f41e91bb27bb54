#include "base/number_picture.h"

#include <algorithm>
#include <cstdlib>
#include <string>

#include "base/date_text.h"
#include "base/number_layout.h"

namespace zebtell::base {

namespace {

using Kind = NumberElement::Kind;

// The digits before and behind the decimal mark; the whole part of a number below 1 is empty.
struct Digits {
    std::string whole;
    std::string fraction;
};

Digits DigitsOf(const Decimal& number, int fraction_places) {
    Digits digits{number.Digits(), ""};
    if (number.scale > 0) {
        const auto scale = static_cast<std::size_t>(number.scale);
        if (digits.whole.size() < scale) digits.whole.insert(0, scale - digits.whole.size(), '0');
        const std::size_t mark = digits.whole.size() - scale;
        digits.fraction = digits.whole.substr(mark);
        digits.whole.erase(mark);
    } else if (!digits.whole.empty()) {
        digits.whole.append(-number.scale, '0');
    }
    digits.fraction.resize(fraction_places, '0');
    return digits;
}

// A number made ready for one section: multiplied, brought to its exponent, rounded.
struct Prepared {
    Decimal number;
    int exponent = 0;
};

Decimal RoundedAwayFromZero(const Decimal& number, int decimals) {
    return number.RoundedTo(decimals, Half::kAwayFromZero);
}

// As many digits before the mark as there are places.
Prepared PreparedScientific(Decimal number, const NumberLayout& layout) {
    if (number.IsZero()) return {number, 0};
    const int size = static_cast<int>(number.Digits().size());
    const int exponent = size - number.scale - layout.integer_places;
    number.scale = size - layout.integer_places;
    Decimal rounded = RoundedAwayFromZero(number, layout.fraction_places);
    const int rounded_size = static_cast<int>(rounded.Digits().size());
    if (rounded_size - rounded.scale <= layout.integer_places) return {rounded, exponent};
    ++rounded.scale;
    return {RoundedAwayFromZero(rounded, layout.fraction_places), exponent + 1};
}

Prepared PreparedFor(Decimal number, const NumberLayout& layout) {
    number.scale -= layout.shift;
    if (layout.scientific) return PreparedScientific(number, layout);
    if (!layout.ShowsNumber()) return {number, 0};
    return {RoundedAwayFromZero(number, layout.fraction_places), 0};
}

// Fills the places of a section with the digits of a number.
class NumberWriter {
  public:
    NumberWriter(std::string& out,
                 const Prepared& prepared,
                 const NumberLayout& layout,
                 const Region& region)
        : out_(out),
          layout_(layout),
          region_(region),
          digits_(DigitsOf(prepared.number, layout.fraction_places)),
          exponent_(prepared.exponent),
          places_left_(layout.integer_places) {
        std::string& fraction = digits_.fraction;
        const auto least = static_cast<std::size_t>(layout.fraction_zeros);
        while (fraction.size() > least && fraction.back() == '0') fraction.pop_back();
    }

    void Write(std::string_view section) {
        NumberReader reader(section);
        for (NumberElement element; reader.Next(element);) WriteElement(element);
    }

  private:
    void WriteElement(const NumberElement& element) {
        switch (element.kind) {
            case Kind::kInteger:
                WriteIntegerPlace();
                break;
            case Kind::kFraction:
                if (fraction_at_ < digits_.fraction.size())
                    out_ += digits_.fraction[fraction_at_++];
                break;
            case Kind::kMark:
                if (layout_.integer_places == 0) WriteSurplus();
                out_ += region_.decimal_mark;
                break;
            case Kind::kComma:
                break;
            case Kind::kExponent:
                WriteExponent(element.text);
                break;
            case Kind::kPercent:
            case Kind::kLiteral:
                out_ += element.text;
                break;
        }
    }

    void WriteIntegerPlace() {
        if (places_left_ == layout_.integer_places) WriteSurplus();
        const int shown = std::max(static_cast<int>(digits_.whole.size()), layout_.integer_zeros);
        if (places_left_ <= shown) WriteDigit(places_left_);
        --places_left_;
    }

    // The digits that have no place of their own.
    void WriteSurplus() {
        for (int at = static_cast<int>(digits_.whole.size()); at > layout_.integer_places; --at) {
            WriteDigit(at);
        }
    }

    // `position` counts from the decimal mark to the left, from 1 on.
    void WriteDigit(int position) {
        const int size = static_cast<int>(digits_.whole.size());
        out_ += position <= size ? digits_.whole[size - position] : '0';
        if (layout_.groups && position > 1 && position % 3 == 1) out_ += region_.group_mark;
    }

    void WriteExponent(std::string_view element) {
        out_ += element[0];
        if (exponent_ < 0) out_ += '-';
        if (exponent_ >= 0 && element[1] == '+') out_ += '+';
        AppendPadded(out_, std::abs(exponent_), static_cast<int>(element.size()) - 2);
    }

    std::string& out_;
    const NumberLayout& layout_;
    const Region& region_;
    Digits digits_;
    int exponent_;
    int places_left_;
    std::size_t fraction_at_ = 0;
};

struct Choice {
    std::string_view section;
    bool minus = false;
};

Choice ChoiceFor(const PictureSections& sections, bool negative, bool zero) {
    const std::string_view first = sections.parts[0];
    if (zero) {
        return {sections.count > 2 && !sections.parts[2].empty() ? sections.parts[2] : first};
    }
    if (!negative) return {first};
    const bool own = sections.count > 1 && !sections.parts[1].empty();
    return own ? Choice{sections.parts[1]} : Choice{first, !first.empty()};
}

}  // namespace

void AppendByPicture(std::string& out,
                     const Decimal& number,
                     const PictureSections& sections,
                     const Region& region) {
    const Choice choice = ChoiceFor(sections, number.negative, number.IsZero());
    const NumberLayout layout(choice.section);
    const Prepared prepared = PreparedFor(number, layout);
    if (prepared.number.IsZero() && !number.IsZero()) {
        AppendBySection(out, {}, ChoiceFor(sections, false, true).section, region);
        return;
    }
    if (choice.minus) out += '-';
    NumberWriter(out, prepared, layout, region).Write(choice.section);
}

void AppendBySection(std::string& out,
                     const Decimal& number,
                     std::string_view section,
                     const Region& region) {
    const NumberLayout layout(section);
    NumberWriter(out, PreparedFor(number, layout), layout, region).Write(section);
}

void AppendTwoDecimals(std::string& out, const Decimal& number, bool groups, const Region& region) {
    const Decimal rounded = RoundedAwayFromZero(number, 2);
    const Digits digits = DigitsOf(rounded, 2);
    if (rounded.negative && !rounded.IsZero()) out += '-';
    if (digits.whole.empty()) out += '0';
    for (std::size_t left = digits.whole.size(); left > 0; --left) {
        out += digits.whole[digits.whole.size() - left];
        if (groups && left > 1 && left % 3 == 1) out += region.group_mark;
    }
    out += region.decimal_mark;
    out += digits.fraction;
}

}  // namespace zebtell::base
