#pragma once

#include <string>

#include "base/format.h"
#include "data/record.h"

namespace zebtell::tags {

// Prices "18" add value-added tax at 18 per cent, whatever the article's own tax is.
inline constexpr double kTax18 = 1.18;

// What an article's own tax multiplies a price by; `field` leads to the percentage.
inline double TaxFactor(data::Record& record,
                        std::string_view field = "GRArticle.GRTax.TaxPercent") {
    const base::Value percent = record.GetField(field);
    return percent.IsBlank() ? 1 : 1 + percent.ToDouble() / 100;
}

// price * factor with two decimals in the region's form.
inline std::string FixedPrice(const base::Value& price, double factor, const base::Region& region) {
    return base::Format(base::Multiplied(price.ToCurrency(), factor, 4), "fixed", region);
}

}  // namespace zebtell::tags
