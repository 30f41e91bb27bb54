#include "tags/field_text.h"

#include <algorithm>

#include "base/format.h"
#include "base/text.h"

namespace zebtell::tags {

const base::Region& RegionOf(const host::SessionState& state) {
    return state.region();
}

std::string Reference(const TagCall& call) {
    return CleanFormValue(call.tag.TemplateContents());
}

void WriteReference(TagCall& call, data::Record* record, std::string_view reference) {
    if (record == nullptr) return call.tag.Hide();
    call.tag.Write(FormatFieldValue(*record, reference, {}, RegionOf(call.state)));
}

void WriteField(TagCall& call, data::Record* record, std::span<const std::string_view> fixed) {
    if (record == nullptr) return call.tag.Write("&nbsp;");
    std::string reference = Reference(call);
    const bool is_fixed = std::any_of(fixed.begin(), fixed.end(), [&](std::string_view name) {
        return base::EqualNoCase(name, reference);
    });
    if (is_fixed) reference += ";fixed";
    WriteReference(call, record, reference);
}

void WritePlainField(TagCall& call, data::Record& record, std::string_view field) {
    call.tag.WriteEscaped(RawText(record, field, RegionOf(call.state)));
}

void WriteByPicture(TagCall& call, const base::Value& value) {
    call.tag.Write(base::Format(value, Reference(call), RegionOf(call.state)));
}

std::string RawText(data::Record& record, std::string_view field, const base::Region& region) {
    const base::Value value = record.GetField(field);
    return value.IsNull() ? std::string() : value.ToText(region);
}

void ShowIf(TagCall& call, bool condition) {
    if (condition) {
        call.tag.Show();
    } else {
        call.tag.Hide();
    }
}

}  // namespace zebtell::tags
