#pragma once

#include <span>
#include <string>
#include <string_view>

#include "check/page_reading.h"

namespace zebtell::check {

// A tag as the template has it.
struct TagText {
    std::string_view name;
    std::string_view lower_name;
    std::string_view contents;
};

// What is known of a tag's contents. Tags without a row have template text inside.
struct TagContents {
    std::string_view page;  // "": on every page
    std::string_view tag;   // in lower case; with a "*" at its end a pattern
    // Contents are a reference to a field of this table; "*" when it has no known one.
    std::string_view table = "";
    std::span<const std::string_view> own_words = {};  // see FieldTag
    // Reports what is wrong with contents of another kind; null: nothing can be.
    void (*check)(PageReading&, const TagText&) = nullptr;
};

// Null when the tag has no row.
const TagContents* FindTagContents(std::string_view page, std::string_view lower_name);

}  // namespace zebtell::check
