#include "tags/custom_func.h"

#include "base/text.h"

namespace zebtell::tags {

namespace {

constexpr std::string_view kNoBreakSpace = "\u00A0";
constexpr std::string_view kWhiteSpace = " \t\r\n";

std::string_view WithoutWhiteSpaceAround(std::string_view text) {
    const std::size_t first = text.find_first_not_of(kWhiteSpace);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(kWhiteSpace) - first + 1);
}

}  // namespace

std::string CleanFormValue(std::string_view text) {
    if (text.find(kNoBreakSpace) == std::string_view::npos) return std::string(base::Trimmed(text));
    return std::string(base::Trimmed(base::Replaced(text, kNoBreakSpace, " ")));
}

std::string CleanPriceQueryText(std::string_view text) {
    std::string clean = base::Replaced(text, kNoBreakSpace, " ");
    clean = base::ReplacedNoCase(clean, "&nbsp;", " ");
    clean = base::ReplacedNoCase(clean, "&lt;", "<");
    clean = base::ReplacedNoCase(clean, "&gt;", ">");
    clean = base::ReplacedNoCase(clean, "&amp;", "&");  // last: "&amp;lt;" means the text "&lt;"
    return std::string(WithoutWhiteSpaceAround(clean));
}

}  // namespace zebtell::tags
