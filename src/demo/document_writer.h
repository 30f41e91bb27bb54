#pragma once

#include <cstdint>
#include <string_view>

#include "demo/database_file.h"
#include "demo/random.h"
#include "demo/trade_document.h"

namespace zebtell::demo {

// Stores documents with their rows, taxes and where they come from. Gives keys and numbers, which
// rise in the order of storing.
class DocumentWriter {
  public:
    explicit DocumentWriter(const DatabaseFile& file);

    void WriteOrder(TradeDocument& order);
    void WriteDelivery(TradeDocument& delivery);
    void WriteInvoice(TradeDocument& invoice);

  private:
    // The key, the GDocument and the links to the document before.
    void Begin(TradeDocument& document, std::string_view kind);
    void WriteTaxes(const TradeDocument& document, const DocumentSums& sums);

    Insert documents_;
    Insert relations_;
    Insert taxes_;
    Insert orders_;
    Insert order_rows_;
    Insert deliveries_;
    Insert delivery_rows_;
    Insert invoices_;
    Insert invoice_rows_;
    Random keys_{4};
    std::int64_t last_document_ = 0;
    std::int64_t last_order_ = 100'000;
    std::int64_t last_delivery_ = 200'000;
    std::int64_t last_invoice_ = 260'000;
    std::int64_t last_order_row_ = 0;
    std::int64_t last_delivery_row_ = 0;
};

}  // namespace zebtell::demo
