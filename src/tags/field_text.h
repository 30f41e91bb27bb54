#pragma once

#include <span>
#include <string>
#include <string_view>

#include "tags/custom_func.h"
#include "tags/field_output.h"
#include "tags/tag_table.h"

namespace zebtell::tags {

// Writes the field of `record` that the contents name, formatted; fields of `fixed` with two
// decimals. "&nbsp;" when there is no record.
void WriteField(TagCall& call, data::Record* record, std::span<const std::string_view> fixed = {});

// A field as plain text, escaped: for text boxes, where "&nbsp;" would be typed text.
void WritePlainField(TagCall& call, data::Record& record, std::string_view field);

}  // namespace zebtell::tags
