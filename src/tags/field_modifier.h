#pragma once

#include <string>
#include <string_view>

#include "base/region.h"
#include "base/value.h"

namespace zebtell::tags {

// A field's value by the modifier behind its ";":
//
//   zebdate   dd.mm.yyyy;zebdate      a date by its picture, "" for the zero date
//   zeb:len=20,quote,nospace          trimmed text: cut to a width, with quotation marks escaped
//   zeb:attr                          trimmed text, for the value of an input that is posted back
//   0.00                              anything else is a format picture
//
// RuntimeError for what does not convert.
std::string ModifiedText(const base::Value& value,
                         std::string_view modifier,
                         const base::Region& region);

// Whether the modifier converts the value, which null does not stand.
bool NeedsValue(std::string_view modifier);

// How the text becomes HTML.
enum class Ending {
    kShown,      // "&nbsp;" for nothing, < and > escaped
    kKeptEmpty,  // the same, but nothing stays nothing
    kAttribute,  // every character that means something in HTML escaped, nothing stays nothing
};
Ending EndingOf(std::string_view modifier);

}  // namespace zebtell::tags
