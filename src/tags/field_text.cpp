#include "tags/field_text.h"

#include <algorithm>

namespace zebtell::tags {

void WriteField(TagCall& call, data::Record* record, std::span<const std::string_view> fixed) {
    if (record == nullptr) {
        call.tag.Write("&nbsp;");
        return;
    }
    std::string reference = Reference(call);
    const bool is_fixed = std::any_of(fixed.begin(), fixed.end(), [&](std::string_view name) {
        return base::EqualNoCase(name, reference);
    });
    if (is_fixed) reference += ";fixed";
    const auto settings = call.state.settings();
    call.tag.Write(FormatFieldValue(*record, reference, "", settings->region()));
}

void WritePlainField(TagCall& call, data::Record& record, std::string_view field) {
    const auto settings = call.state.settings();
    const base::Value value = record.GetField(field);
    call.tag.WriteEscaped(value.IsBlank() ? "" : value.ToText(settings->region()));
}

}  // namespace zebtell::tags
