#pragma once

#include <cstdint>
#include <map>
#include <vector>

#include "demo/catalogue.h"
#include "demo/companies.h"
#include "demo/demo_company.h"
#include "demo/document_writer.h"
#include "demo/order_maker.h"
#include "demo/random.h"
#include "demo/trade_document.h"

namespace zebtell::demo {

// Lets the company trade day by day: orders come in, deliveries follow them and invoices those,
// until today. What would happen later has not happened: young orders are open and young invoices
// unpaid.
class Trade {
  public:
    Trade(CompanyStore& store,
          const Catalogue& catalogue,
          const std::vector<Buyer>& buyers,
          const DemoOptions& options);

    void Run();

  private:
    using Calendar = std::map<int, std::vector<TradeDocument>>;  // by day

    void TakeOrders(int day, std::int64_t rows_until_then);
    void StoreOrder(TradeDocument order);
    void PlanDelivery(const TradeDocument& order, int day, const std::vector<double>& quantities);
    void Deliver(int day);
    void PlanInvoice(const TradeDocument& delivery);
    void Bill(int day);
    int WorkdayFrom(int day) const;

    int first_day_;
    int today_;
    int last_workday_;
    std::int64_t wanted_rows_;
    std::int64_t rows_ = 0;
    OrderMaker orders_;
    DocumentWriter writer_;
    Random random_{5};
    Calendar deliveries_;
    Calendar invoices_;
};

}  // namespace zebtell::demo
