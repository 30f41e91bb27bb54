#include "demo/document_writer.h"

#include <string>

namespace zebtell::demo {
namespace {

using base::Currency;

constexpr int kOfficeHour = 9;

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

base::DateTime SomeTimeOf(base::DateTime date, Random& random) {
    base::CalendarTime time = date.Calendar();
    time.hour = kOfficeHour + random.Below(8);
    time.minute = random.Below(60);
    time.second = random.Below(60);
    return base::DateTime::FromCalendar(time);
}

Currency PaidOf(const TradeDocument& invoice, const DocumentSums& sums) {
    const Currency all = sums.amount + sums.tax;
    return invoice.paid_in_full ? all : base::PercentOf(all, invoice.paid_percent, 2);
}

}  // namespace

DocumentWriter::DocumentWriter(const DatabaseFile& file)
    : documents_(file, "GDocument", {"ID", "Kind", "DocKey", "Created"}),
      relations_(file, "GDocRel", {"IDGDocument", "IDSrcGDocument"}),
      taxes_(file, "GDTax", {"IDGDocument", "TaxPercent", "Base", "Amount"}),
      // clang-format off
      orders_(file, "SDOrder",
              {"ID", "Number", "DocDate", "WantedDate", "State", "IDGRCompany",
               "IDGRCompContPerson", "IDGRPriceList", "CompanyName", "CompanyAddr", "Explanation",
               "Amount", "TaxAmount", "AmountWTax", "NeedsReview"}),
      order_rows_(file, "SDOrderRow",
                  {"ID", "IDSDOrder", "RowNo", "IDGRArticle", "Quantity", "Price", "UnitPrice",
                   "PriceCut", "Amount", "TaxPercent", "Explanation", "DeliveredQuantity",
                   "Status"}),
      deliveries_(file, "SDConsignmD",
                  {"ID", "Number", "DocDate", "State", "IDGRCompany", "IDGRCompContPerson",
                   "IDGRPriceList", "CompanyName", "CompanyAddr", "Explanation", "Amount",
                   "TaxAmount", "AmountWTax"}),
      delivery_rows_(file, "DDStoreDRow",
                     {"ID", "IDSDConsignmD", "RowNo", "IDSDOrderRow", "IDGRArticle", "Quantity",
                      "Price", "UnitPrice", "PriceCut", "Amount", "TaxPercent", "Explanation",
                      "Status"}),
      invoices_(file, "SDInvoice",
                {"ID", "Number", "DocDate", "DueDate", "State", "IDGRCompany",
                 "IDGRCompContPerson", "IDGRPriceList", "CompanyName", "CompanyAddr",
                 "Explanation", "Amount", "TaxAmount", "AmountWTax", "PaidAmount"}),
      invoice_rows_(file, "SDInvoiceRow",
                    {"IDSDInvoice", "RowNo", "IDDDStoreDRow", "IDGRArticle", "Quantity", "Price",
                     "UnitPrice", "PriceCut", "Amount", "TaxPercent", "Explanation", "Status"})
// clang-format on
{}

void DocumentWriter::Begin(TradeDocument& document, std::string_view kind) {
    document.id = ++last_document_;
    documents_.Row(document.id, kind, KeyText(keys_), SomeTimeOf(document.date, keys_));
    if (document.source != 0) {
        relations_.Row(document.id, document.source);
    }
}

void DocumentWriter::WriteTaxes(const TradeDocument& document, const DocumentSums& sums) {
    for (const TaxLine& line : sums.taxes) {
        taxes_.Row(document.id, line.percent, line.base, line.amount);
    }
}

void DocumentWriter::WriteOrder(TradeDocument& order) {
    Begin(order, "SDOrder");
    order.number = ++last_order_;
    const DocumentSums sums = SumsOf(order.rows);
    const Buyer& buyer = *order.buyer;
    orders_.Row(order.id,
                order.number,
                order.date,
                order.wanted,
                order.state,
                buyer.id,
                Link{buyer.contact},
                buyer.price_list,
                order.company_name,
                order.company_address,
                order.explanation,
                sums.amount,
                sums.tax,
                sums.amount + sums.tax,
                order.needs_review);
    int row_no = 0;
    for (TradeRow& row : order.rows) {
        row.id = ++last_order_row_;
        order_rows_.Row(row.id,
                        order.id,
                        ++row_no,
                        row.article->id,
                        row.quantity,
                        row.price,
                        row.list_price,
                        row.price_cut,
                        row.amount,
                        row.article->tax_percent,
                        row.explanation,
                        row.delivered,
                        row.status);
    }
    WriteTaxes(order, sums);
}

void DocumentWriter::WriteDelivery(TradeDocument& delivery) {
    Begin(delivery, "SDConsignmD");
    delivery.number = ++last_delivery_;
    const DocumentSums sums = SumsOf(delivery.rows);
    const Buyer& buyer = *delivery.buyer;
    deliveries_.Row(delivery.id,
                    delivery.number,
                    delivery.date,
                    delivery.state,
                    buyer.id,
                    Link{buyer.contact},
                    buyer.price_list,
                    delivery.company_name,
                    delivery.company_address,
                    delivery.explanation,
                    sums.amount,
                    sums.tax,
                    sums.amount + sums.tax);
    int row_no = 0;
    for (TradeRow& row : delivery.rows) {
        row.id = ++last_delivery_row_;
        delivery_rows_.Row(row.id,
                           delivery.id,
                           ++row_no,
                           row.source_row,
                           row.article->id,
                           row.quantity,
                           row.price,
                           row.list_price,
                           row.price_cut,
                           row.amount,
                           row.article->tax_percent,
                           row.explanation,
                           row.status);
    }
    WriteTaxes(delivery, sums);
}

void DocumentWriter::WriteInvoice(TradeDocument& invoice) {
    Begin(invoice, "SDInvoice");
    invoice.number = ++last_invoice_;
    const DocumentSums sums = SumsOf(invoice.rows);
    const Buyer& buyer = *invoice.buyer;
    invoices_.Row(invoice.id,
                  invoice.number,
                  invoice.date,
                  invoice.due,
                  invoice.state,
                  buyer.id,
                  Link{buyer.contact},
                  buyer.price_list,
                  invoice.company_name,
                  invoice.company_address,
                  invoice.explanation,
                  sums.amount,
                  sums.tax,
                  sums.amount + sums.tax,
                  PaidOf(invoice, sums));
    int row_no = 0;
    for (const TradeRow& row : invoice.rows) {
        invoice_rows_.Row(invoice.id,
                          ++row_no,
                          row.source_row,
                          row.article->id,
                          row.quantity,
                          row.price,
                          row.list_price,
                          row.price_cut,
                          row.amount,
                          row.article->tax_percent,
                          row.explanation,
                          row.status);
    }
    WriteTaxes(invoice, sums);
}

}  // namespace zebtell::demo
