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
//   0.00                              anything else is a format picture
//
// RuntimeError for what does not convert.
std::string ModifiedText(const base::Value& value,
                         std::string_view modifier,
                         const base::Region& region);

// Whether the modifier converts the value, which null does not stand.
bool NeedsValue(std::string_view modifier);

// Whether the modifier lets an empty result stay empty.
bool KeepsEmpty(std::string_view modifier);

}  // namespace zebtell::tags
