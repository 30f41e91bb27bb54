#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

namespace zebtell::markup {

// <!--#include file="name"--> as it stands in a text.
struct Include {
    std::size_t begin = 0;
    std::size_t end = 0;
    std::string_view file;
};

// The first from `from` on.
std::optional<Include> FindInclude(std::string_view text, std::size_t from);

}  // namespace zebtell::markup
