#include "erp/order_review.h"

#include <algorithm>

#include "erp/order_price.h"

namespace zebtell::erp {
namespace {

OwnPrices PricesNow(const Order& order, Connection& connection) {
    std::vector<std::int64_t> articles;
    for (const auto& row : order.rows) {
        articles.push_back(row->fields.Integer("IDGRArticle"));
    }
    const Session& session = *order.session();
    const Reader& reader = session.reader();
    const auto cursor = connection.Query(
        session.database().translator().Select(reader, OwnPricesSql(reader, articles)));
    RowSet rows(std::make_shared<const FieldSet>(cursor->Columns()));
    while (cursor->Next()) {
        rows.Append(*cursor);
    }
    return ReadOwnPrices(reader, rows);
}

bool IsBelow(const OrderRow& row, base::Currency own) {
    const RecordFields& fields = row.fields;
    return fields.Money("Price") < own || (row.unit_price_set && fields.Money("UnitPrice") < own) ||
           fields.Money("Amount") < base::Multiplied(own, fields.Number("Quantity"), 2);
}

}  // namespace

bool NeedsReview(const Order& order, Connection& connection) {
    const OwnPrices prices = PricesNow(order, connection);
    return std::any_of(order.rows.begin(), order.rows.end(), [&prices](const auto& row) {
        if (row->IsFixed() || !row->IsToStore()) {
            return false;
        }
        const auto own = prices.find(row->fields.Integer("IDGRArticle"));
        return own == prices.end() || IsBelow(*row, own->second.price);
    });
}

}  // namespace zebtell::erp
