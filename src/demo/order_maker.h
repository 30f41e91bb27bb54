#pragma once

#include <cstdint>
#include <vector>

#include "demo/catalogue.h"
#include "demo/companies.h"
#include "demo/random.h"
#include "demo/trade_document.h"

namespace zebtell::demo {

// Makes what customers order: who, what and how much, at his own prices. Keeps references to the
// catalogue and the buyers.
class OrderMaker {
  public:
    OrderMaker(const Catalogue& catalogue, const std::vector<Buyer>& buyers);

    // A new order of 1 to most_rows articles; the ERP may have added a transport row.
    // `with_blocked` is a time when the companies that may not order now still did.
    TradeDocument Make(base::DateTime date, int most_rows, bool with_blocked);
    // The same of the company of that position.
    TradeDocument MakeFor(std::size_t company, base::DateTime date, int most_rows);

  private:
    std::size_t PickCompany(bool with_blocked);
    void AddRows(TradeDocument& order, const std::vector<TradeRow>& assortment, int count);
    void AddTransport(TradeDocument& order);

    const Catalogue& catalogue_;
    const std::vector<Buyer>& buyers_;
    Random random_{6};
    std::vector<std::vector<TradeRow>> assortments_;  // by the buyers' positions
    std::vector<std::size_t> turns_;  // positions of buyers, who buys more stands here more often
};

}  // namespace zebtell::demo
