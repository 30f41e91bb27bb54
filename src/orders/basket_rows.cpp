#include "orders/basket_rows.h"

#include "base/ignore_errors.h"
#include "base/rounding.h"

namespace zebtell::orders {
namespace {

using base::Currency;
using data::Record;

constexpr Currency kNoPrice;

Currency MoneyOf(Record& row, std::string_view field) {
    const base::Value value = row.GetField(field);
    return value.IsBlank() ? kNoPrice : value.ToCurrency();
}

double QuantityOf(Record& row) {
    const base::Value value = row.GetField("Quantity");
    return value.IsBlank() ? 0 : value.ToDouble();
}

// Writes quantity and prices into the row and lets the data layer recalculate it.
void Price(Record& row, double quantity, Currency price, Currency unit_price) {
    row.SetField("Quantity", quantity);
    if (price != kNoPrice) row.SetField("Amount", base::Multiplied(price, quantity, 2));
    if (unit_price != kNoPrice) row.SetField("UnitPrice", unit_price.Rounded(4));
    row.Update(0);
    row.SetField("@RowPrice", MoneyOf(row, "Amount"));
}

void Fill(Record& row, std::int64_t article, double quantity, const AskedPrices& asked) {
    row.SetField("IDGRArticle", article);
    const Currency price = asked.price != kNoPrice ? asked.price : MoneyOf(row, "Price");
    row.SetField("@unitprice", price);
    Price(row, quantity, price, asked.unit_price);
}

}  // namespace

void AddBasketRow(data::BasketValues& basket,
                  std::int64_t article,
                  double quantity,
                  const AskedPrices& asked) {
    const std::int16_t count = base::ToInteger16(basket.BasketRowCount + 1.0);
    const auto row = basket.BasketRows->AddRow();
    try {
        Fill(*row, article, quantity, asked);
    } catch (...) {
        base::IgnoreErrors([&] { row->Delete(); });
        throw;
    }
    basket.BasketRowCount = count;
    basket.BasketQuantity += quantity;
    basket.BasketTotal += MoneyOf(*row, "@RowPrice");
}

void ChangeQuantity(data::BasketValues& basket,
                    Record& row,
                    double quantity,
                    const AskedPrices& asked) {
    const double old_quantity = QuantityOf(row);
    if (old_quantity == quantity) return;
    const Currency old_amount = MoneyOf(row, "Amount");
    const Currency price = asked.price != kNoPrice ? asked.price : MoneyOf(row, "@unitprice");
    const Currency unit_price =
        asked.unit_price != kNoPrice ? asked.unit_price : MoneyOf(row, "UnitPrice");
    Price(row, quantity, price, unit_price);
    base::IgnoreErrors([&] {
        basket.BasketQuantity += quantity - old_quantity;
        basket.BasketTotal += MoneyOf(row, "@RowPrice") - old_amount;
    });
}

}  // namespace zebtell::orders
