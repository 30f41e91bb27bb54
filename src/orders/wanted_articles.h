#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "base/currency.h"
#include "host/session_state.h"
#include "orders/basket_rows.h"
#include "orders/refusals.h"

namespace zebtell::orders {

// One article that the catalogue's form asks for.
struct WantedArticle {
    std::string name;   // the article's code, as far as it is known: for messages
    std::string typed;  // the quantity box
    std::string box;    // the form field to say a refusal beside
    double quantity = 0;
    std::int64_t article = 0;
    AskedPrices asked;
};

// The quantity boxes of price list rows ("ID_" and the row's ID) and the quick entry ("Code_f1",
// "Quantity_f1", ..., and the lines of "QuickEntry"), in the order of the form and with the prices
// that count. What has no article or no quantity above 0 goes to `refusals`; boxes that are empty
// or 0 do not count.
std::vector<WantedArticle> ReadWantedArticles(host::SessionState& state,
                                              const web::Request& request,
                                              Refusals& refusals);

}  // namespace zebtell::orders
