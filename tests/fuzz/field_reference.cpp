#include "base/region.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "markup/tag_scan.h"
#include "tags/custom_func.h"
#include "tests/fuzz/harness.h"
#include "tests/support/fake_data.h"

// A template's field reference in the first line, its format in the second; the others are what
// somebody has typed into the field.

namespace zebtell::fuzz {
namespace {

base::Value Number(std::string_view text) {
    const auto number = base::ParseNumber(text);
    return number ? base::Value(*number) : base::Value::Null();
}

base::Value Date(std::string_view text) {
    try {
        return base::Value(text).ToDateTime(base::RegionFor("et"));
    } catch (const base::RuntimeError&) {
        return base::Value::Null();
    }
}

bool IsAttribute(std::string_view reference) {
    return base::StartsWithNoCase(reference, "f;zeb:attr") && reference.find('|') == reference.npos;
}

}  // namespace

void Try(std::string_view input) {
    const auto reference = TakeLine(input);
    const auto format = TakeLine(input);
    const auto record = fake::MakeRecord(
        {{"f", input}, {"n", Number(input)}, {"d", Date(input)}, {"x", base::Value::Null()}});
    const std::string html =
        tags::FormatFieldValue(*record, reference, format, base::RegionFor("et"));
    // What a template writes itself, as the output of a condition, may be markup.
    if (reference.find_first_of("<>") == reference.npos) {
        Claim(html.find_first_of("<>") == html.npos, "typed text is no markup", html);
    }
    if (reference.find('<') == reference.npos) Claim(!markup::MayHoldTags(html), "nor a tag", html);
    if (IsAttribute(reference) && !base::EndsWithNoCase(reference, ";zebdate")) {
        Claim(html.find_first_of("<>\"'") == html.npos, "nor does it end an attribute", html);
    }
    Claim(html.size() <= 20 * (input.size() + 1) + 800 * (reference.size() + format.size() + 1),
          "it does not grow",
          html.substr(0, 100));
}

}  // namespace zebtell::fuzz
