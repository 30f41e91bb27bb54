#include "orders/basket_rows.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/support/fake_data.h"

namespace zebtell::orders {
namespace {

using base::Currency;

Currency Money(const char* text) {
    return base::Value(text).ToCurrency();
}

class BasketRows : public ::testing::Test {
  protected:
    BasketRows() {
        basket.Basket = document;
        basket.BasketRows = document->rows;
    }

    // A row as the data layer has it, counted in the totals.
    std::shared_ptr<fake::Record> StandingRow(double quantity, const char* amount) {
        auto row = fake::MakeRecord({{"Quantity", quantity},
                                     {"Amount", Money(amount)},
                                     {"UnitPrice", Money("2.5")},
                                     {"@unitprice", Money("2.5")}});
        document->rows->rows.push_back(row);
        basket.BasketRowCount = 1;
        basket.BasketQuantity = quantity;
        basket.BasketTotal = Money(amount);
        return row;
    }
    // "rows quantity total"
    std::string Totals() const {
        return std::to_string(basket.BasketRowCount) + " " +
               base::Value(basket.BasketQuantity).ToPlainText() + " " +
               base::Value(basket.BasketTotal).ToPlainText();
    }

    std::shared_ptr<fake::Document> document = std::make_shared<fake::Document>();
    data::BasketValues basket;
};

TEST_F(BasketRows, AddedRowsAreCountedByTheirSums) {
    AddBasketRow(basket, 7, 2.5, {.price = Money("1.01"), .unit_price = Money("3.123456")});
    const fake::Record& row = *document->rows->rows.at(0);
    EXPECT_EQ(row.fields.at("Amount"), base::Value(Money("2.52")));  // 2.525, half to even
    EXPECT_EQ(row.fields.at("UnitPrice"), base::Value(Money("3.1235")));
    EXPECT_EQ(row.fields.at("@unitprice"), base::Value(Money("1.01")));
    EXPECT_EQ(row.updates, 1);
    AddBasketRow(basket, 8, 1, {Money("10"), {}});
    EXPECT_EQ(Totals(), "2 3.5 12.52");
}

TEST_F(BasketRows, ARowThatCannotBeMadeLeavesTheBasket) {
    StandingRow(4, "10");
    // The database fills in no price here, and none is asked for.
    EXPECT_THROW(AddBasketRow(basket, 7, 1, {}), base::RuntimeError);
    EXPECT_TRUE(document->rows->rows.at(1)->deleted);
    EXPECT_EQ(Totals(), "1 4 10");
    basket.BasketRowCount = 32767;
    EXPECT_THROW(AddBasketRow(basket, 7, 1, {Money("1"), {}}), base::RuntimeError);
    EXPECT_EQ(document->rows->rows.size(), 2U) << "no row more than can be counted";
}

TEST_F(BasketRows, ChangedQuantities) {
    struct Case {
        const char* label;
        double quantity;
        const char* price;       // asked for
        const char* unit_price;  // asked for
        const char* amount;      // the row's
        const char* unit;
        const char* totals;
    };
    const Case cases[] = {
        {"at the price it was added with", 6, "0", "0", "15", "2.5", "1 6 15"},
        {"at a price asked for", 3, "1.999", "0", "6", "2.5", "1 3 6"},
        {"with another unit price", 1, "0", "9.87654", "2.5", "9.8765", "1 1 2.5"},
        {"to nothing: the row stays", 0, "0", "0", "0", "2.5", "1 0 0"},
        {"the same: prices do not count", 4, "99", "99", "10", "2.5", "1 4 10"},
    };
    for (const Case& c : cases) {
        document->rows->rows.clear();
        const auto row = StandingRow(4, "10");
        ChangeQuantity(basket, *row, c.quantity, {Money(c.price), Money(c.unit_price)});
        EXPECT_EQ(row->fields.at("Amount"), base::Value(Money(c.amount))) << c.label;
        EXPECT_EQ(row->fields.at("UnitPrice"), base::Value(Money(c.unit))) << c.label;
        EXPECT_EQ(Totals(), c.totals) << c.label;
    }
}

TEST_F(BasketRows, WithoutAnyPriceTheDatabaseDecides) {
    const auto row = StandingRow(4, "10");
    row->fields["@unitprice"] = Currency();
    row->on_update = [](fake::Record& updated) { updated.fields["Amount"] = Money("7.77"); };
    ChangeQuantity(basket, *row, 5, {});
    // The total moves by the new row sum and the old amount.
    EXPECT_EQ(Totals(), "1 5 7.77");
    EXPECT_EQ(row->fields.at("@RowPrice"), base::Value(Money("7.77")));
}

}  // namespace
}  // namespace zebtell::orders
