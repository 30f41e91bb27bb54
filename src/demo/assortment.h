#pragma once

#include <vector>

#include "demo/catalogue.h"
#include "demo/companies.h"
#include "demo/random.h"
#include "demo/trade_document.h"

namespace zebtell::demo {

// What a company buys again and again: 24 to 72 articles (fewer when the catalogue is small) of
// its price list, as rows at its own prices without a quantity.
std::vector<TradeRow> AssortmentOf(const Buyer& buyer, const Catalogue& catalogue, Random& random);

}  // namespace zebtell::demo
