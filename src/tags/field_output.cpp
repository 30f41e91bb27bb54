#include "tags/field_output.h"

#include "base/format.h"
#include "tags/custom_func.h"

namespace zebtell::tags {

const base::Region& RegionOf(const host::SessionState& state) {
    return state.settings()->region();
}

std::string Reference(const TagCall& call) {
    return CleanFormValue(call.tag.TemplateContents());
}

void WriteField(TagCall& call,
                data::Record* record,
                std::string_view reference,
                std::string_view format) {
    if (record == nullptr) return call.tag.Hide();
    call.tag.Write(FormatFieldValue(*record, reference, format, RegionOf(call.state)));
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
