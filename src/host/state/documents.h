#pragma once

#include "base/date_time.h"
#include "data/document_loaders.h"

namespace zebtell::host {

struct DateRange {
    base::DateTime From;
    base::DateTime To;
};

// The customer's last orders on the start page, while it is written.
struct RecentOrders {
    std::shared_ptr<data::RecordList> List;
    std::int64_t Shown = 0;  // rows written
    std::shared_ptr<data::Record> Current;
};

// Stored documents on their pages, and the periods that the document lists show.
struct DocumentsState {
    DateRange Orders;
    DateRange Deliveries;
    DateRange Invoices;
    data::ShownDocument ShownOrder;
    data::ShownDocument ShownConsignment;
    data::ShownDocument ShownInvoice;
    RecentOrders Recent;
    // The article information page's article and its prices for the customer.
    std::shared_ptr<data::Record> Article;
    std::shared_ptr<data::Record> ArticlePrices;
};

}  // namespace zebtell::host
