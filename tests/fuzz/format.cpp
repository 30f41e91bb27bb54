#include "base/format.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "tests/fuzz/harness.h"

// The picture in the first line, the value in the others: a number, a date or any text.

namespace zebtell::fuzz {
namespace {

constexpr std::size_t kLongest = 1000;
// A number has at most some 330 digits, a date's parts are short names.
constexpr std::size_t kPerCharacter = 800;

base::Value ValueOf(std::string_view text, const base::Region& region) {
    try {
        if (text.starts_with("date ")) return base::Value(text.substr(5)).ToDateTime(region);
        if (text.starts_with("money ")) return base::Value(text.substr(6)).ToCurrency();
        if (text.starts_with("whole ")) return base::Value(text.substr(6)).ToInteger64();
        if (text.starts_with("flag ")) return base::Value(text.substr(5)).ToBoolean();
        if (text.starts_with("number ")) return base::Value(text.substr(7)).ToDouble();
    } catch (const base::RuntimeError&) {
        return base::Value::Null();
    }
    return text;
}

void TryIn(const base::Region& region, std::string_view picture, std::string_view text) {
    const base::Value value = ValueOf(text, region);
    std::string written;
    try {
        written = base::Format(value, picture, region);
    } catch (const base::RuntimeError&) {
        return;
    }
    Claim(written.size() <= kPerCharacter * (picture.size() + text.size() + 1),
          "a text grows with its picture only");
    Claim(!base::IsValidUtf8(picture) || !base::IsValidUtf8(text) || base::IsValidUtf8(written),
          "good text stays good",
          written);
    Claim(written == base::Format(value, picture, region), "it is always the same");
    if (picture.empty() && !value.IsNull())
        Claim(written == value.ToText(region), "no picture, no change", written);
    if (const auto* amount = value.As<base::Currency>(); amount && picture == "0.0000")
        Claim(base::Value(written).ToCurrency() == *amount, "four decimals lose nothing", written);
}

}  // namespace

void Try(std::string_view input) {
    if (input.size() > kLongest) return;
    const auto picture = TakeLine(input);
    for (const char* region : {"et", "lv", "en"}) TryIn(base::RegionFor(region), picture, input);
}

}  // namespace zebtell::fuzz
