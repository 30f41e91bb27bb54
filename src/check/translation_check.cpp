#include "check/translation_check.h"

#include <algorithm>

namespace zebtell::check {
namespace {

// Everything between "<" and ">", sorted: a translation may put words into another order.
std::vector<std::string_view> TagsOf(std::string_view text) {
    std::vector<std::string_view> tags;
    for (auto begin = text.find('<'); begin != text.npos; begin = text.find('<', begin + 1)) {
        tags.push_back(text.substr(begin, text.find('>', begin) - begin));
    }
    std::sort(tags.begin(), tags.end());
    return tags;
}

}  // namespace

void CheckTranslations(PageReading& reading) {
    for (const auto& text : reading.source.texts) {
        const auto report = [&](std::string_view fault) {
            const std::string message = std::string(fault) + " \"" + text.message + "\"";
            reading.findings.push_back({text.place.file, text.place.line, message});
        };
        if (text.translation.empty()) {
            report("no translation of");
        } else if (TagsOf(text.translation) != TagsOf(text.message)) {
            report("the translation has not the tags of");
        }
    }
}

}  // namespace zebtell::check
