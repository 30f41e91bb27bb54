#include "base/format.h"

#include <optional>

#include "base/date_picture.h"
#include "base/date_text.h"
#include "base/decimal.h"
#include "base/number_picture.h"
#include "base/picture.h"
#include "base/text.h"
#include "base/text_picture.h"

namespace zebtell::base {

namespace {

using Kind = Value::Kind;

std::optional<Decimal> NumberOf(const Value& value, const Region& region) {
    if (const auto* integer = value.As<std::int64_t>()) return Decimal::FromInteger(*integer);
    if (const auto* amount = value.As<Currency>()) {
        return Decimal::FromInteger(amount->scaled(), Currency::kDecimals);
    }
    if (const auto* text = value.As<std::string>()) {
        if (const auto number = ParseNumber(*text)) return Decimal::FromDouble(*number);
        if (const auto date = ParseDate(*text, region)) return Decimal::FromDouble(date->days());
        return std::nullopt;
    }
    return Decimal::FromDouble(value.ToDouble());
}

// What has no calendar date, such as a number that is too great, is no date.
std::optional<DateTime> DateOf(const Value& value, const Region& region) {
    std::optional<DateTime> date;
    if (const auto* text = value.As<std::string>()) {
        date = ParseDate(*text, region);
        const auto number = date ? std::nullopt : ParseNumber(*text);
        if (number) date = DateTime(*number);
    } else {
        date = value.ToDateTime(region);
    }
    return date && date->HasCalendar() ? date : std::nullopt;
}

// A format with a way of its own: one function for what it is made from, the other stays empty.
// The two commonest pictures of prices are here too, since reading a picture takes longer than
// writing the number.
struct NamedFormat {
    std::string_view name;
    void (*number)(std::string& out, const Decimal& number, const Region& region);
    void (*date)(std::string& out, DateTime date, const Region& region);
};

using Out = std::string&;
using Number = const Decimal&;
using Where = const Region&;

void AppendPercent(Out out, Number number, Where region) {
    Decimal percent = number;
    percent.scale -= 2;
    AppendTwoDecimals(out, percent, false, region);
    out += '%';
}

void AppendCurrency(Out out, Number number, Where region) {
    AppendByPicture(out, number, SectionsOf(region.currency_picture), region);
}

void AppendScientific(Out out, Number number, Where region) {
    AppendByPicture(out, number, SectionsOf("0.00E+00"), region);
}

void AppendFixed(Out out, Number number, Where region) {
    AppendTwoDecimals(out, number, false, region);
}

void AppendStandard(Out out, Number number, Where region) {
    AppendTwoDecimals(out, number, true, region);
}

constexpr NamedFormat kNamedFormats[] = {
    {"Fixed", AppendFixed, nullptr},
    {"0.00", AppendFixed, nullptr},
    {"Standard", AppendStandard, nullptr},
    {"#,##0.00", AppendStandard, nullptr},
    {"Currency", AppendCurrency, nullptr},
    {"Percent", AppendPercent, nullptr},
    {"Scientific", AppendScientific, nullptr},
    {"Yes/No", [](Out out, Number n, Where r) { out += n.IsZero() ? r.no : r.yes; }, nullptr},
    {"True/False",
     [](Out out, Number n, Where r) { out += n.IsZero() ? r.false_text : r.true_text; },
     nullptr},
    {"On/Off", [](Out out, Number n, Where r) { out += n.IsZero() ? r.off : r.on; }, nullptr},
    {"General Date",
     nullptr,
     [](Out out, DateTime d, Where r) { AppendGeneralDate(out, d.Calendar(), r); }},
    {"Long Date",
     nullptr,
     [](Out out, DateTime d, Where r) { AppendByDatePicture(out, d, r.long_date_picture, r); }},
    {"Medium Date",
     nullptr,
     [](Out out, DateTime d, Where r) { AppendByDatePicture(out, d, "dd-mmm-yy", r); }},
    {"Short Date",
     nullptr,
     [](Out out, DateTime d, Where r) { AppendShortDate(out, d.Calendar(), r); }},
    {"Long Time",
     nullptr,
     [](Out out, DateTime d, Where r) { AppendLongTime(out, d.Calendar(), r); }},
    {"Medium Time",
     nullptr,
     [](Out out, DateTime d, Where r) { AppendByDatePicture(out, d, "hh:nn AMPM", r); }},
    {"Short Time",
     nullptr,
     [](Out out, DateTime d, Where r) { AppendByDatePicture(out, d, "hh:nn", r); }},
};

constexpr std::string_view kGeneralNumber = "General Number";

const NamedFormat* FindNamedFormat(std::string_view picture) {
    for (const NamedFormat& format : kNamedFormats) {
        // The size first, as this is asked for every picture.
        if (format.name.size() == picture.size() && EqualNoCase(format.name, picture)) {
            return &format;
        }
    }
    return nullptr;
}

std::string ByName(const Value& value, const NamedFormat& format, const Region& region) {
    std::string out;
    if (format.number != nullptr) {
        const auto number = NumberOf(value, region);
        if (!number) return value.ToText(region);
        format.number(out, *number, region);
    } else {
        const auto date = DateOf(value, region);
        if (!date) return value.ToText(region);
        format.date(out, *date, region);
    }
    return out;
}

// As the number that it stands for, when it is one.
std::string GeneralNumber(const Value& value, const Region& region) {
    if (value.kind() == Kind::kInteger || value.kind() == Kind::kCurrency) {
        return value.ToText(region);
    }
    const auto number = NumberOf(value, region);
    return number ? Value(number->ToDouble()).ToText(region) : value.ToText(region);
}

PictureSubject SubjectOf(const Value& value) {
    if (value.kind() == Kind::kText) return PictureSubject::kText;
    return value.kind() == Kind::kDateTime ? PictureSubject::kDate : PictureSubject::kNumber;
}

std::string ByTextPicture(const Value& value, std::string_view picture, const Region& region) {
    const PictureSections sections = SectionsOf(picture);
    const std::string text = value.ToText(region);
    const bool own = text.empty() && sections.count > 1;
    std::string out;
    AppendByTextPicture(out, text, sections.parts[own ? 1 : 0]);
    return out;
}

std::string ByPicture(const Value& value, std::string_view picture, const Region& region) {
    const PictureKind kind = KindOf(picture, SubjectOf(value));
    if (kind == PictureKind::kText) return ByTextPicture(value, picture, region);
    std::string out;
    if (kind == PictureKind::kDate) {
        const auto date = DateOf(value, region);
        if (!date) return value.ToText(region);
        AppendByDatePicture(out, *date, SectionsOf(picture).parts[0], region);
    } else {
        const auto number = NumberOf(value, region);
        if (!number) return value.ToText(region);
        AppendByPicture(out, *number, SectionsOf(picture), region);
    }
    return out;
}

// Only a section made for it shows that there is no value.
std::string ForNull(std::string_view picture, const Region& region) {
    const PictureSections sections = SectionsOf(picture);
    std::string out;
    if (sections.count == 4) AppendBySection(out, {}, sections.parts[3], region);
    return out;
}

}  // namespace

std::string Format(const Value& value, std::string_view picture, const Region& region) {
    if (value.IsNull()) return ForNull(picture, region);
    if (picture.empty()) return value.ToText(region);
    if (const NamedFormat* format = FindNamedFormat(picture)) {
        return ByName(value, *format, region);
    }
    if (EqualNoCase(picture, kGeneralNumber)) return GeneralNumber(value, region);
    return ByPicture(value, picture, region);
}

}  // namespace zebtell::base
