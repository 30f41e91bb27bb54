#pragma once

#include <span>
#include <string_view>

#include "check/page_reading.h"

namespace zebtell::check {

// A tag whose contents are a field reference.
struct FieldTag {
    std::string_view name;   // "ZEB:SDOrder", in the template
    std::string_view table;  // "": nobody knows the fields beforehand
    // References that the tag knows itself and writes without quotation marks. "FinalPrice*" is
    // all that begins so.
    std::span<const std::string_view> own_words = {};
};

// Reports fields that the table does not have, modifiers that mean nothing, and fields written to
// `place` without what that place needs.
void CheckReference(PageReading& reading,
                    const FieldTag& tag,
                    std::string_view reference,
                    HtmlReader::Place place);

// The outputs of a reference's conditions, which are template text; views into the reference.
std::vector<std::string_view> ConditionOutputs(std::string_view reference);

}  // namespace zebtell::check
