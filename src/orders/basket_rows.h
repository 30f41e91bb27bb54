#pragma once

#include <cstdint>

#include "base/currency.h"
#include "data/basket.h"

namespace zebtell::orders {

// What a row is counted with; 0 means that nothing was asked for.
struct AskedPrices {
    base::Currency price;       // per unit, for the row sum
    base::Currency unit_price;  // the unit price that the row shows
};

// The largest quantity that an order row takes.
inline constexpr double kMostQuantity = 1e9;

// Appends a row and counts it in the totals. Without an asked price the data layer's own price for
// the customer counts. When anything fails the basket is as it was.
void AddBasketRow(data::BasketValues& basket,
                  std::int64_t article,
                  double quantity,
                  const AskedPrices& asked);

// Gives a row another quantity, with the price asked for or the one that it was added with, and
// moves the totals.
void ChangeQuantity(data::BasketValues& basket,
                    data::Record& row,
                    double quantity,
                    const AskedPrices& asked);

}  // namespace zebtell::orders
