#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "base/region.h"
#include "data/data_application.h"

namespace zebtell::tags {

// The option elements of a table, one line a record:
//
//   table;value field;text field;order[;attributes[;more[;criteria]]]
//
// "#V" in the attributes is the record's value, "#F" in the criteria `customer_key`. Nothing for a
// definition with fewer than four fields.
std::string ComboOptions(data::DataApplication& application,
                         std::string_view definition,
                         std::int32_t customer_key,
                         const base::Region& region);

// A text as an attribute's value without quotation marks: what would end it or begin markup becomes
// an entity, ordinary text stays as it is.
std::string BareAttribute(std::string_view text);

}  // namespace zebtell::tags
