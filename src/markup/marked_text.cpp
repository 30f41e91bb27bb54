#include "markup/marked_text.h"

#include <algorithm>

#include "base/text.h"
#include "markup/tag_scan.h"

namespace zebtell::markup {
namespace {

constexpr std::string_view kBlanks = " \t\r\n";

std::optional<TagMark> FindTextMark(std::string_view text, std::size_t from) {
    auto mark = FindTag(text, from);
    while (mark && !base::EqualNoCase(mark->name, "ZEB:Text")) mark = FindTag(text, mark->end);
    return mark;
}

// The end that belongs to a start before `from`.
std::optional<TagMark> FindTextEnd(std::string_view text, std::size_t from) {
    std::size_t open = 1;
    for (auto mark = FindTextMark(text, from); mark; mark = FindTextMark(text, mark->end)) {
        if (mark->kind == TagMark::Kind::kStart) ++open;
        if (mark->kind == TagMark::Kind::kEnd && --open == 0) return mark;
    }
    return std::nullopt;
}

// Behind the markup that begins at `at`: a portal tag with its contents, or an element's tag.
std::size_t MarkupEnd(std::string_view text, std::size_t at) {
    const auto start = FindTag(text, at);
    if (!start || start->begin != at) {
        const std::size_t end = text.find('>', at);
        return end == text.npos ? text.size() : end + 1;
    }
    if (start->kind != TagMark::Kind::kStart) return start->end;
    std::size_t open = 1;
    for (auto mark = FindTag(text, start->end); mark; mark = FindTag(text, mark->end)) {
        if (!base::EqualNoCase(mark->name, start->name)) continue;
        if (mark->kind == TagMark::Kind::kStart) ++open;
        if (mark->kind == TagMark::Kind::kEnd && --open == 0) return mark->end;
    }
    return start->end;
}

}  // namespace

std::optional<MarkedText> FindMarkedText(std::string_view text, std::size_t from) {
    for (auto mark = FindTextMark(text, from); mark; mark = FindTextMark(text, mark->end)) {
        if (mark->kind != TagMark::Kind::kStart) continue;
        const auto end = FindTextEnd(text, mark->end);
        if (!end) continue;
        const auto contents = text.substr(mark->end, end->begin - mark->end);
        if (!MessageOf(contents).empty()) return MarkedText{mark->begin, end->end, contents};
    }
    return std::nullopt;
}

std::string MessageOf(std::string_view contents) {
    std::string message;
    for (std::size_t at = contents.find_first_not_of(kBlanks); at < contents.size();) {
        const std::size_t end = std::min(contents.find_first_of(kBlanks, at), contents.size());
        if (!message.empty()) message += ' ';
        message.append(contents, at, end - at);
        at = contents.find_first_not_of(kBlanks, end);
    }
    return message;
}

std::string InTemplate(std::string_view translation) {
    std::string text;
    for (std::size_t at = 0; at < translation.size();) {
        const char c = translation[at];
        const std::size_t end = c == '<' ? MarkupEnd(translation, at) : at + 1;
        // &apos; and not its number: "#" has a meaning in the conditions of field references.
        if (c == '"') {
            text += "&quot;";
        } else if (c == '\'') {
            text += "&apos;";
        } else {
            text.append(translation, at, end - at);
        }
        at = end;
    }
    return text;
}

}  // namespace zebtell::markup
