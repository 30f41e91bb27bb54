#include "markup/tag_scan.h"

#include <array>
#include <cstring>

namespace zebtell::markup {
namespace {

constexpr std::string_view kPrefix = "zeb:";

constexpr std::array<bool, 256> MakeNameBytes() {
    std::array<bool, 256> bytes{};
    for (int c = '0'; c <= '9'; ++c) bytes[c] = true;
    for (int c = 'A'; c <= 'Z'; ++c) bytes[c] = bytes[c - 'A' + 'a'] = true;
    for (int c = 0x80; c <= 0xFF; ++c) bytes[c] = true;
    bytes['_'] = bytes['-'] = bytes['.'] = true;
    return bytes;
}

constexpr auto kNameBytes = MakeNameBytes();

bool IsNameByte(char c) {
    return kNameBytes[static_cast<unsigned char>(c)];
}

bool HasPrefixAt(std::string_view text, std::size_t at) {
    if (text.size() - at < kPrefix.size()) return false;
    // Setting bit 5 turns a capital into its small letter, and ":" into itself.
    for (std::size_t i = 0; i < kPrefix.size(); ++i)
        if ((text[at + i] | 0x20) != kPrefix[i]) return false;
    return text[at + kPrefix.size() - 1] == ':';
}

std::size_t NameEnd(std::string_view text, std::size_t at) {
    while (at < text.size() && IsNameByte(text[at])) ++at;
    return at;
}

// The tag whose "<" stands at `begin`.
std::optional<TagMark> TagAt(std::string_view text, std::size_t begin) {
    std::size_t at = begin + 1;
    const bool is_end = at < text.size() && text[at] == '/';
    if (is_end) ++at;
    if (!HasPrefixAt(text, at)) return std::nullopt;
    const std::size_t name_end = NameEnd(text, at + kPrefix.size());
    const std::string_view name = text.substr(at, name_end - at);
    if (name.size() == kPrefix.size()) return std::nullopt;
    at = name_end;
    const bool is_empty = !is_end && at < text.size() && text[at] == '/';
    if (is_empty) ++at;
    if (at >= text.size() || text[at] != '>') return std::nullopt;
    const auto kind = is_end     ? TagMark::Kind::kEnd
                      : is_empty ? TagMark::Kind::kEmpty
                                 : TagMark::Kind::kStart;
    return TagMark{kind, begin, at + 1, name};
}

std::size_t FindAngle(std::string_view text, std::size_t from) {
    if (from >= text.size()) return std::string_view::npos;
    const void* found = std::memchr(text.data() + from, '<', text.size() - from);
    return found == nullptr
               ? std::string_view::npos
               : static_cast<std::size_t>(static_cast<const char*>(found) - text.data());
}

}  // namespace

std::optional<TagMark> FindTag(std::string_view text, std::size_t from) {
    for (std::size_t at = FindAngle(text, from); at != std::string_view::npos;
         at = FindAngle(text, at + 1)) {
        if (auto mark = TagAt(text, at)) return mark;
    }
    return std::nullopt;
}

bool MayHoldTags(std::string_view text) {
    for (std::size_t at = FindAngle(text, 0); at != std::string_view::npos;
         at = FindAngle(text, at + 1)) {
        if (HasPrefixAt(text, at + 1)) return true;
    }
    return false;
}

bool IsTagName(std::string_view name) {
    return HasPrefixAt(name, 0) && name.size() > kPrefix.size() &&
           NameEnd(name, kPrefix.size()) == name.size();
}

}  // namespace zebtell::markup
