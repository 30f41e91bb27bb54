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
    WriteField(call, record, reference);
}

void WritePlainField(TagCall& call, data::Record& record, std::string_view field) {
    call.tag.WriteEscaped(RawText(record, field, RegionOf(call.state)));
}

}  // namespace zebtell::tags
