#pragma once

#include <string>
#include <string_view>

#include "base/decimal.h"
#include "base/picture.h"
#include "base/region.h"

namespace zebtell::base {

// The number by the sections positive;negative;zero of a number picture. A number that rounds to
// zero counts as zero.
void AppendByPicture(std::string& out,
                     const Decimal& number,
                     const PictureSections& sections,
                     const Region& region);

// By one section, whatever the number's sign.
void AppendBySection(std::string& out,
                     const Decimal& number,
                     std::string_view section,
                     const Region& region);

// With two decimals: what the pictures "0.00" and, with groups, "#,##0.00" give.
void AppendTwoDecimals(std::string& out, const Decimal& number, bool groups, const Region& region);

}  // namespace zebtell::base
