#include "data/basket.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "data/document_loaders.h"
#include "data/price_query_text.h"
#include "tests/support/fake_data.h"

namespace zebtell::data {
namespace {

using base::Currency;
using base::Value;
using testing::ElementsAre;

// "company contact rows quantity total", or "none".
std::string Described(const BasketValues& basket) {
    if (!basket.Basket) return basket.BasketRows ? "rows without a basket" : "none";
    auto& header = dynamic_cast<fake::Record&>(*basket.Basket->Header());
    std::string text;
    for (const char* field : {"IDGRCompany", "IDGRCompContPerson"}) {
        const auto found = header.fields.find(field);
        text += (found == header.fields.end() ? "-" : found->second.ToPlainText()) + " ";
    }
    return text + std::to_string(basket.BasketRowCount) + " " +
           Value(basket.BasketQuantity).ToPlainText() + " " + basket.BasketTotal.ToText();
}

TEST(Basket, IsMadeOnceForItsOwner) {
    fake::Application application;
    BasketValues basket;
    EXPECT_TRUE(CreateBasket(basket, application, {.IDPartner = 7, .IDGRCompContPerson = 3}));
    EXPECT_EQ(Described(basket), "7 3 0 0 0");
    EXPECT_EQ(basket.BasketRows, basket.Basket->Rows());

    const auto first = basket.Basket;
    EXPECT_TRUE(CreateBasket(basket, application, {.IDPartner = 8}));
    EXPECT_EQ(basket.Basket, first);
    EXPECT_THAT(application.asked, ElementsAre("OpenTable SDOrder|"));

    DiscardBasket(basket);
    EXPECT_EQ(Described(basket), "none");
    CreateBasket(basket, application, {.IDPartner = 8});
    EXPECT_EQ(Described(basket), "8 - 0 0 0");
}

TEST(Basket, FailureLeavesNone) {
    fake::Application application;
    application.error = base::RuntimeError(base::errors::kUnspecified);
    BasketValues basket;
    EXPECT_TRUE(CreateBasket(basket, application, {.IDPartner = 7}));
    EXPECT_EQ(Described(basket), "none");
}

TEST(Basket, DiscardClearsTotals) {
    fake::Application application;
    BasketValues basket;
    CreateBasket(basket, application, {.IDPartner = 7});
    basket.BasketRowCount = 2;
    basket.BasketQuantity = 4;
    basket.BasketTotal = Currency::FromText("9.5");
    DiscardBasket(basket);
    EXPECT_EQ(basket.BasketRowCount, 0);
    EXPECT_EQ(basket.BasketQuantity, 0);
    EXPECT_EQ(basket.BasketTotal, Currency());
}

TEST(Loaders, ShownDocuments) {
    const struct {
        void (*load)(DataApplication&, std::string_view, ShownDocument&);
        const char* table;
        const char* rows_table;
    } rows[] = {
        {LoadShownOrder, "SDOrder", "SDOrderRow"},
        {LoadConsignment, "SDConsignmD", "DDStoreDRow"},
        {LoadInvoice, "SDInvoice", "SDInvoiceRow"},
    };
    for (const auto& row : rows) {
        fake::Application application;
        const auto list = fake::MakeList({{{"ID", 17}}});
        list->rows[0]->children[row.rows_table] = fake::MakeList({{{"ID", 1}}, {{"ID", 2}}});
        application.lists[std::string(row.table) + "|ID=17"] = list;
        application.lists[row.table] = std::make_shared<fake::List>();

        for (const char* filter : {"ID=17", "ID_17"}) {
            ShownDocument shown;
            shown.RowCursor = 9;
            row.load(application, filter, shown);
            EXPECT_EQ(shown.Header, list->rows[0]) << row.table << filter;
            EXPECT_EQ(shown.RowCount, 2);
            EXPECT_EQ(shown.Rows->Count(), 2);
            EXPECT_EQ(shown.TaxCount, 0);
            ASSERT_NE(shown.Taxes, nullptr);
            EXPECT_EQ(shown.RowCursor, 1);
            EXPECT_EQ(application.asked.back(), "OpenList " + std::string(row.table) + "|ID=17|");
            for (const char* missing : {"ID_18", "", "ID"}) {
                EXPECT_THROW(row.load(application, missing, shown), base::RuntimeError);
                EXPECT_EQ(shown.Header, list->rows[0]) << "replaced by " << missing;
            }
        }
    }
}

TEST(Loaders, StoredOrderAsBasket) {
    fake::Application application;
    const auto order = std::make_shared<fake::Document>();
    order->rows = fake::MakeList({{{"Quantity", 2.5}, {"Amount", Currency::FromText("10.10")}},
                                  {{"Quantity", 4}, {"Amount", Currency::FromText("0.05")}}});
    application.documents["SDOrder|ID=17"] = {order};

    BasketValues basket;
    LoadOrderAsBasket(application, "ID_17", basket);
    EXPECT_EQ(Described(basket), "- - 2 6.5 10.15");
    EXPECT_EQ(basket.Basket, order);
    EXPECT_EQ(basket.BasketRows, order->rows);

    EXPECT_THROW(LoadOrderAsBasket(application, "ID_18", basket), base::RuntimeError);
    EXPECT_EQ(Described(basket), "- - 2 6.5 10.15");
}

TEST(PriceQueryText, Lines) {
    const std::string text = DefaultPriceQueryText();
    const auto lines = base::Split(text, '\n');
    ASSERT_EQ(lines.size(), 15U);
    EXPECT_EQ(lines[0],
              "select s5.*, rc.idgrcompany, isnull(pricecut, 0) as pricecut,"
              "round (price * (100 + isnull(pricecut, 0)), 0) / 100 as finalprice\r");
    EXPECT_EQ(lines[8],
              "inner join grarticle ga with (nolock)"
              " on ga.idgrarticlepricecat=rel.idgrarticlepricecat\r");
    EXPECT_EQ(lines[14], "and s5.idgrarticle in (#A)");
    for (std::size_t index = 0; index + 1 < lines.size(); ++index) {
        EXPECT_TRUE(lines[index].ends_with('\r')) << index;
    }
}

}  // namespace
}  // namespace zebtell::data
