#pragma once

#include <optional>
#include <string_view>

namespace zebtell::markup {

// One tag as it stands in a text: "<ZEB:Name>", "</ZEB:Name>" or "<ZEB:Name/>".
struct TagMark {
    enum class Kind { kStart, kEnd, kEmpty };

    Kind kind = Kind::kStart;
    std::size_t begin = 0;  // of the "<"
    std::size_t end = 0;    // behind the ">"
    std::string_view name;  // "ZEB:Name"
};

// The first well-formed tag from `from` on.
std::optional<TagMark> FindTag(std::string_view text, std::size_t from);

// Whether the text can hold a tag: "<ZEB:" in any case.
bool MayHoldTags(std::string_view text);

// "ZEB:" and a name of letters, digits, "_", "-" and ".". Bytes of letters beyond ASCII count as
// letters.
bool IsTagName(std::string_view name);

}  // namespace zebtell::markup
