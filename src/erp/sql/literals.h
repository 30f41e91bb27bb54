#pragma once

#include <string_view>

#include "base/date_time.h"
#include "base/value.h"

namespace zebtell::erp::sql {

// An integer, or a double for numbers with a mark and those beyond 64 bits.
base::Value NumberOf(std::string_view digits);

// "mm/dd/yyyy", with an optional time "hh:mm" or "hh:mm:ss" behind a blank; also the ISO form.
base::DateTime DateOf(std::string_view text);

// Turns a number's sign round; false for values that are no numbers.
bool Negate(base::Value& value);

}  // namespace zebtell::erp::sql
