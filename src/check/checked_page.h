#pragma once

#include <string_view>
#include <vector>

#include "tags/tag_table.h"

namespace zebtell::check {

// What the check knows of a page.
struct CheckedPage {
    std::string_view name;
    std::string_view template_file;
    std::vector<std::string_view> events = {};  // exact names
    // Event names made at run time that mean something, as patterns: "ID_*".
    std::vector<std::string_view> event_patterns = {};
    const tags::TagTable* own_tags = nullptr;  // null: the page has none
};

}  // namespace zebtell::check
