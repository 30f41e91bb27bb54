#pragma once

#include <cstdint>
#include <initializer_list>
#include <string_view>

#include "demo/company_store.h"
#include "demo/random.h"
#include "demo/trade_document.h"

namespace zebtell::demo {

// Stores documents with their rows, taxes and where they come from. Gives keys and numbers, which
// rise in the order of storing.
class DocumentWriter {
  public:
    explicit DocumentWriter(CompanyStore& store);

    void WriteOrder(TradeDocument& order);
    void WriteDelivery(TradeDocument& delivery);
    void WriteInvoice(TradeDocument& invoice);

  private:
    // One kind of document.
    struct Kind {
        std::string_view name;
        Insert headers;
        Insert rows;
        std::int64_t last_number;
        std::int64_t last_row = 0;
    };
    // The columns that only this kind has come behind those that all have.
    struct KindColumns {
        std::string_view table;
        std::initializer_list<std::string_view> own;
        std::string_view row_table;
        std::string_view row_link;  // the column that leads from a row to its document
        std::string_view row_own;
        std::int64_t last_number;
    };
    static Kind MakeKind(CompanyStore& store, const KindColumns& columns);

    // The GDocument, the link to the document before and the taxes.
    DocumentSums Begin(TradeDocument& document, Kind& kind);
    template <class... Own>
    void WriteHeader(Kind& kind,
                     const TradeDocument& document,
                     const DocumentSums& sums,
                     const Own&... own);
    template <class OwnOf>
    void WriteRows(Kind& kind, TradeDocument& document, OwnOf own_of);

    Insert documents_;
    Insert relations_;
    Insert taxes_;
    Kind orders_;
    Kind deliveries_;
    Kind invoices_;
    Random random_{4};
    std::int64_t last_document_ = 0;
};

}  // namespace zebtell::demo
