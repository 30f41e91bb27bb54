#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "base/currency.h"
#include "base/date_time.h"
#include "demo/catalogue.h"
#include "demo/companies.h"

namespace zebtell::demo {

// A row of an order, a delivery note or an invoice.
struct TradeRow {
    std::int64_t id = 0;
    std::int64_t source_row = 0;  // the row of the document before: order, delivery, invoice
    const Article* article = nullptr;
    double quantity = 0;
    base::Currency amount;      // of the quantity
    base::Currency price;       // what the customer pays for one
    base::Currency list_price;  // of one
    double price_cut = 0;       // per cent between the two
    double delivered = 0;       // of the quantity; in orders
    int status = 0;             // 4: made by the ERP
    std::string_view explanation;

    void SetQuantity(double new_quantity) {
        quantity = new_quantity;
        amount = base::Multiplied(price, quantity, 2);
    }
};

// An order, a delivery note or an invoice; what only one of them has is last.
struct TradeDocument {
    std::int64_t id = 0;
    std::int64_t number = 0;
    std::int64_t source = 0;  // the document that it follows from, 0 for orders
    base::DateTime date;
    int state = 0;
    const Buyer* buyer = nullptr;
    std::string_view company_name;
    std::string_view company_address;
    std::string_view explanation;
    std::vector<TradeRow> rows;
    base::DateTime wanted;      // order
    bool needs_review = false;  // order
    base::DateTime due;         // invoice
    bool paid_in_full = false;  // invoice
    int paid_percent = 0;       // invoice, when it is not paid in full
};

struct TaxLine {
    double percent = 0;
    base::Currency base;
    base::Currency amount;
};

// The sums of a document: each percentage is taxed once, on the sum of its rows.
struct DocumentSums {
    std::vector<TaxLine> taxes;  // by percentage, the highest first
    base::Currency amount;
    base::Currency tax;
};

DocumentSums SumsOf(const std::vector<TradeRow>& rows);

}  // namespace zebtell::demo
