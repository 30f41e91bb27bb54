#pragma once

#include <string>

#include "base/format.h"

namespace zebtell::tags {

// Prices "18" add value-added tax at 18 per cent, whatever the article's own tax is.
inline constexpr double kTax18 = 1.18;

// price * factor with two decimals in the region's form.
inline std::string FixedPrice(const base::Value& price, double factor, const base::Region& region) {
    return base::Format(base::Multiplied(price.ToCurrency(), factor, 4), "fixed", region);
}

}  // namespace zebtell::tags
