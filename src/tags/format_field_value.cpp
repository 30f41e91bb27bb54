#include "base/format.h"
#include "base/ignore_errors.h"
#include "base/text.h"
#include "markup/escape.h"
#include "tags/custom_func.h"
#include "tags/field_condition.h"
#include "tags/field_modifier.h"

namespace zebtell::tags {

namespace {

constexpr std::string_view kNothing = "&nbsp;";
constexpr std::size_t npos = std::string_view::npos;

// The parts of a reference read the same record.
struct Source {
    data::Record& record;
    std::string_view format;
    const base::Region& region;

    base::Value Field(std::string_view name) const { return record.GetField(base::Trimmed(name)); }
};

// "&nbsp;" for nothing, < and > escaped. Browsers would drop a NUL or keep it as they like.
std::string FieldHtml(std::string text) {
    if (text.empty()) return std::string(kNothing);
    if (text.find('\0') != npos) {
        text = base::Replaced(text, std::string_view("\0", 1), "\xEF\xBF\xBD");
    }
    // Two searches by byte are several times faster than one for either.
    if (text.find('<') == npos && text.find('>') == npos) return text;
    return base::Replaced(base::Replaced(text, "<", "&lt;"), ">", "&gt;");
}

// Null has no text: a field that holds it ends the call like an error, without the cost of one.

std::string Bare(const Source& source, std::string_view field) {
    const base::Value value = source.Field(field);
    if (!source.format.empty()) return FieldHtml(base::Format(value, source.format, source.region));
    return value.IsNull() ? std::string() : FieldHtml(value.ToText(source.region));
}

std::string Modified(const Source& source, std::string_view field, std::string_view modifier) {
    const base::Value value = source.Field(field);
    if (value.IsNull() && NeedsValue(modifier)) return {};
    std::string text = ModifiedText(value, modifier, source.region);
    const Ending ending = EndingOf(modifier);
    if (ending == Ending::kAttribute) return markup::Escaped(text);
    return text.empty() && ending == Ending::kKeptEmpty ? text : FieldHtml(std::move(text));
}

std::string Conditional(const Source& source, std::string_view reference) {
    const auto condition = ParseCondition(reference);
    if (!condition) return {};
    const base::Value value = source.Field(condition->field);
    if (value.IsNull()) return {};
    const std::string text = value.ToText(source.region);
    return std::string(Holds(*condition, base::Trimmed(text)) ? condition->output : "");
}

std::string OnePart(const Source& source, std::string_view reference) {
    std::string result;
    base::IgnoreErrors([&] {
        if (reference.starts_with('?')) {
            result = Conditional(source, reference.substr(1));
        } else if (const std::size_t at = reference.find(';'); at != npos) {
            result = Modified(source, reference.substr(0, at), reference.substr(at + 1));
        } else {
            result = Bare(source, reference);
        }
    });
    return result;
}

std::string FirstWithText(const Source& source, std::string_view reference) {
    for (const std::string_view part : base::Split(reference, '|')) {
        std::string text = OnePart(source, part);
        if (!text.empty() && text != kNothing) return text;
    }
    return {};
}

}  // namespace

std::string FormatFieldValue(data::Record& record,
                             std::string_view reference,
                             std::string_view format,
                             const base::Region& region) {
    const Source source{record, format, region};
    return reference.find('|') == npos ? OnePart(source, reference)
                                       : FirstWithText(source, reference);
}

}  // namespace zebtell::tags
