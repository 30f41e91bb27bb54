#pragma once

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "base/currency.h"
#include "erp/access.h"
#include "erp/row_set.h"

namespace zebtell::erp {

// What an article costs the customer, per unit and without tax.
struct OwnPrice {
    base::Currency price;
    double price_cut = 0;  // per cent on the list price; negative: a discount
    double tax_percent = 0;
};

using OwnPrices = std::unordered_map<std::int64_t, OwnPrice>;  // by article

// The list price with the percentage of the customer's price category: whole cents, half away from
// zero, exact decimals.
base::Currency PriceWithCut(base::Currency list_price, double price_cut);

// The select statement that reads the prices of articles in the reader's price lists.
std::string OwnPricesSql(const Reader& reader, const std::vector<std::int64_t>& articles);

// Its result. Where several lists have an article, the reader's first list counts; an article that
// none has is not there.
OwnPrices ReadOwnPrices(const Reader& reader, const RowSet& rows);

}  // namespace zebtell::erp
