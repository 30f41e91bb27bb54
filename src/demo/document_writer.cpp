#include "demo/document_writer.h"

#include <string>
#include <vector>

namespace zebtell::demo {
namespace {

using base::Currency;
using Columns = std::vector<std::string_view>;

std::string KeyText(Random& random) {
    constexpr std::string_view kDigits = "0123456789abcdef";
    std::string text;
    for (int half = 0; half < 2; ++half) {
        std::uint64_t bits = random.Next();
        for (int digit = 0; digit < 16; ++digit, bits >>= 4U) {
            text += kDigits[bits & 15U];
        }
    }
    return text;
}

base::DateTime OfficeTimeOf(base::DateTime date, Random& random) {
    base::CalendarTime time = date.Calendar();
    time.hour = random.Between(9, 16);
    time.minute = random.Below(60);
    time.second = random.Below(60);
    return base::DateTime::FromCalendar(time);
}

Currency PaidOf(const TradeDocument& invoice, const DocumentSums& sums) {
    const Currency all = sums.amount + sums.tax;
    return invoice.paid_in_full ? all : base::PercentOf(all, invoice.paid_percent, 2);
}

}  // namespace

DocumentWriter::Kind DocumentWriter::MakeKind(CompanyStore& store, const KindColumns& columns) {
    Columns header = {"ID",
                      "Number",
                      "DocDate",
                      "State",
                      "IDGRCompany",
                      "IDGRCompContPerson",
                      "IDGRPriceList",
                      "CompanyName",
                      "CompanyAddr",
                      "Explanation",
                      "Amount",
                      "TaxAmount",
                      "AmountWTax"};
    header.insert(header.end(), columns.own.begin(), columns.own.end());
    const Columns row = {"ID",
                         columns.row_link,
                         "RowNo",
                         "IDGRArticle",
                         "Quantity",
                         "Price",
                         "UnitPrice",
                         "PriceCut",
                         "Amount",
                         "TaxPercent",
                         "Explanation",
                         "Status",
                         columns.row_own};
    return {columns.table,
            Insert(store, columns.table, header),
            Insert(store, columns.row_table, row),
            columns.last_number};
}

DocumentWriter::DocumentWriter(CompanyStore& store)
    : documents_(store, "GDocument", {"ID", "Kind", "DocKey", "Created"}),
      relations_(store, "GDocRel", {"IDGDocument", "IDSrcGDocument"}),
      taxes_(store, "GDTax", {"IDGDocument", "TaxPercent", "Base", "Amount"}),
      orders_(MakeKind(store,
                       {"SDOrder",
                        {"WantedDate", "NeedsReview"},
                        "SDOrderRow",
                        "IDSDOrder",
                        "DeliveredQuantity",
                        100'000})),
      deliveries_(MakeKind(
          store, {"SDConsignmD", {}, "DDStoreDRow", "IDSDConsignmD", "IDSDOrderRow", 200'000})),
      invoices_(MakeKind(store,
                         {"SDInvoice",
                          {"DueDate", "PaidAmount"},
                          "SDInvoiceRow",
                          "IDSDInvoice",
                          "IDDDStoreDRow",
                          260'000})) {}

DocumentSums DocumentWriter::Begin(TradeDocument& document, Kind& kind) {
    document.id = ++last_document_;
    document.number = ++kind.last_number;
    const std::string key = KeyText(random_);
    documents_.Row(document.id, kind.name, key, OfficeTimeOf(document.date, random_));
    if (document.source != 0) {
        relations_.Row(document.id, document.source);
    }
    DocumentSums sums = SumsOf(document.rows);
    for (const TaxLine& line : sums.taxes) {
        taxes_.Row(document.id, line.percent, line.base, line.amount);
    }
    return sums;
}

template <class... Own>
void DocumentWriter::WriteHeader(Kind& kind,
                                 const TradeDocument& document,
                                 const DocumentSums& sums,
                                 const Own&... own) {
    kind.headers.Row(document.id,
                     document.number,
                     document.date,
                     document.state,
                     document.buyer->id,
                     Link{document.buyer->contact},
                     document.buyer->price_list,
                     document.company_name,
                     document.company_address,
                     document.explanation,
                     sums.amount,
                     sums.tax,
                     sums.amount + sums.tax,
                     own...);
}

template <class OwnOf>
void DocumentWriter::WriteRows(Kind& kind, TradeDocument& document, OwnOf own_of) {
    int row_no = 0;
    for (TradeRow& row : document.rows) {
        row.id = ++kind.last_row;
        kind.rows.Row(row.id,
                      document.id,
                      ++row_no,
                      row.article->id,
                      row.quantity,
                      row.price,
                      row.price,
                      row.price_cut,
                      row.amount,
                      row.article->tax_percent,
                      row.explanation,
                      row.status,
                      own_of(row));
    }
}

void DocumentWriter::WriteOrder(TradeDocument& order) {
    const DocumentSums sums = Begin(order, orders_);
    WriteHeader(orders_, order, sums, order.wanted, order.needs_review);
    WriteRows(orders_, order, [](const TradeRow& row) { return row.delivered; });
}

void DocumentWriter::WriteDelivery(TradeDocument& delivery) {
    const DocumentSums sums = Begin(delivery, deliveries_);
    WriteHeader(deliveries_, delivery, sums);
    WriteRows(deliveries_, delivery, [](const TradeRow& row) { return Link{row.source_row}; });
}

void DocumentWriter::WriteInvoice(TradeDocument& invoice) {
    const DocumentSums sums = Begin(invoice, invoices_);
    WriteHeader(invoices_, invoice, sums, invoice.due, PaidOf(invoice, sums));
    WriteRows(invoices_, invoice, [](const TradeRow& row) { return Link{row.source_row}; });
}

}  // namespace zebtell::demo
