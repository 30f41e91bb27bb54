#include "erp/order_review.h"

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

// An article without a price, or with the price 0, has none that could be kept to.
std::optional<base::Currency> ReviewPrice(const OrderRow& row, const OwnPrices& prices) {
    if (row.IsFixed() || !row.IsToStore()) {
        return std::nullopt;
    }
    const auto found = prices.find(row.fields.Integer("IDGRArticle"));
    const base::Currency own = found == prices.end() ? base::Currency() : found->second.price;
    const bool has_none = own == base::Currency();
    return has_none || IsBelow(row, own) ? std::optional(own) : std::nullopt;
}

}  // namespace

std::vector<std::optional<base::Currency>> ReviewPrices(const Order& order,
                                                        Connection& connection) {
    const OwnPrices prices = PricesNow(order, connection);
    std::vector<std::optional<base::Currency>> review_prices;
    for (const auto& row : order.rows) {
        review_prices.push_back(ReviewPrice(*row, prices));
    }
    return review_prices;
}

}  // namespace zebtell::erp
