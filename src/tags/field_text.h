#pragma once

#include <span>
#include <string>
#include <string_view>

#include "base/region.h"
#include "base/value.h"
#include "data/record.h"
#include "tags/custom_func.h"
#include "tags/tag_table.h"

namespace zebtell::tags {

// How the portal writes numbers and dates for people.
const base::Region& RegionOf(const host::SessionState& state);

// The tag's contents as a field reference, cleaned as posted texts are.
std::string Reference(const TagCall& call);

// Writes the record's field that `reference` names; nothing when there is no record.
void WriteReference(TagCall& call, data::Record* record, std::string_view reference);

// Writes the record's field that the contents name; the fields of `fixed` with two decimals.
// "&nbsp;" when there is no record, so that a table's cell keeps its shape.
void WriteField(TagCall& call, data::Record* record, std::span<const std::string_view> fixed = {});

// A field as plain text, escaped: for text boxes, where "&nbsp;" would be typed text.
void WritePlainField(TagCall& call, data::Record& record, std::string_view field);

// Writes a value by the picture that the contents hold, as plain text when they are empty.
void WriteByPicture(TagCall& call, const base::Value& value);

// A field's value as the database holds it; "" for null.
std::string RawText(data::Record& record, std::string_view field, const base::Region& region);

void ShowIf(TagCall& call, bool condition);

}  // namespace zebtell::tags
