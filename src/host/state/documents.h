#pragma once

#include "base/date_time.h"
#include "data/document_loaders.h"

namespace zebtell::host {

struct DateRange {
    base::DateTime From;
    base::DateTime To;
};

// Stored documents on their pages, and the periods that the document lists show.
struct DocumentsState {
    DateRange Orders;
    DateRange Deliveries;
    DateRange Invoices;
    data::ShownDocument ShownOrder;
    data::ShownDocument ShownConsignment;
    data::ShownDocument ShownInvoice;
    std::shared_ptr<data::Record> Article;  // the article information page's
};

}  // namespace zebtell::host
