#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace zebtell::tags {

// A conditional reference, without its "?": field, operator, what to compare with, ";", output.
//
//   State=0;open     Name='A*';starts with A     Code=(A1,B2);one of them     Stock<10;few
//
// Views into the reference.
struct FieldCondition {
    std::string_view field;
    std::string_view compare;
    std::string_view output;
    std::string_view reference;
};

// Nothing when there is no ";" or no operator before it.
std::optional<FieldCondition> ParseCondition(std::string_view reference);

// Whether the output is to be shown for the field's trimmed text. An operator counts wherever it
// stands in the reference, the output included: templates are written with that in mind.
// RuntimeError 13 when "<" or ">" meets what is no number, 93 for a wrong pattern.
bool Holds(const FieldCondition& condition, std::string_view value);

}  // namespace zebtell::tags
