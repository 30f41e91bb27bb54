#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

using base::Currency;
using base::Value;
using base::errors::kInvalidCall;
using base::errors::kStatementFailed;
using base::errors::kTypeMismatch;

class OrderTest : public PortalTest {
  protected:
    void SetUp() override {
        portal_ = LogOn();
        order_ = portal_->OpenTable("SDOrder")->Open(0);
    }
    std::shared_ptr<data::Record> Add(int article, double quantity) {
        auto row = order_->Rows()->AddRow();
        row->SetField("IDGRArticle", article);
        row->SetField("Quantity", quantity);
        row->Update(0);
        return row;
    }

    std::unique_ptr<data::DataApplication> portal_;
    std::shared_ptr<data::Document> order_;
};
INSTANTIATE_TEST_SUITE_P(Databases,
                         OrderTest,
                         testing::ValuesIn(DatabaseKinds()),
                         [](const auto& test) { return test.param.name; });

TEST_P(OrderTest, ANewOrderShowsItsDefaultsAtOnce) {
    const struct {
        const char *field, *text;
    } rows[] = {
        {"ID", "0"},
        {"DocDate", "2026-03-15"},
        {"State", "0"},
        {"IDGRCompany", "1"},
        {"IDGRPriceList", "3"},
        {"GRPriceList.Currency", "EUR"},
        {"CompanyName", "Puit OÜ"},
        {"CompanyAddr", "Tamme 5, 10115 Tallinn"},
        {"GRCompany.Parent.Name", "Ema AS"},
        {"Explanation", ""},
        {"Amount", "0"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(order_->GetField(row.field).ToPlainText(), row.text) << row.field;
        EXPECT_EQ(Text(*order_->Header(), row.field), row.text) << row.field;
    }
    EXPECT_TRUE(order_->GetField("WantedDate").IsNull());
    EXPECT_EQ(ErrorOf([&] { order_->GetField("Nothing"); }), kStatementFailed);
    EXPECT_EQ(ErrorOf([&] { order_->Rows()->Item(1); }), base::errors::kSubscript);
}

// The price of a row is the list price with the price category's percentage, whole cents, half
// away from zero; the amount is to the cent, half to even.
TEST_P(OrderTest, RowsArePricedToTheCent) {
    const struct {
        int article;
        double quantity;
        const char *price, *price_cut, *amount;
    } rows[] = {
        {1, 1, "0.88", "-12.5", "0.88"},      // 0.875
        {3, 2, "2.63", "-12.5", "5.26"},      // 2.625
        {5, 0.5, "4.38", "-12.5", "2.19"},    // 4.375
        {2, 3, "2", "0", "6"},                // no category
        {7, 0.125, "6.13", "-12.5", "0.77"},  // 6.125; 0.76625
        {4, 1e9, "4", "0", "4000000000"},
        {2, 0, "2", "0", "0"},
    };
    for (const auto& row : rows) {
        const auto added = Add(row.article, row.quantity);
        EXPECT_EQ(Text(*added, "Price"), row.price) << row.article;
        EXPECT_EQ(Text(*added, "UnitPrice"), row.price) << row.article;
        EXPECT_EQ(Text(*added, "PriceCut"), row.price_cut) << row.article;
        EXPECT_EQ(Text(*added, "Amount"), row.amount) << row.article;
    }
}

TEST_P(OrderTest, AskedAmountsMakeThePrice) {
    const auto row = Add(2, 3);
    const auto ask = [&](double quantity, const char* amount) {
        row->SetField("Quantity", quantity);
        row->SetField("Amount", amount);
        row->Update(0);
        return Text(*row, "Amount") + " at " + Text(*row, "Price");
    };
    EXPECT_EQ(ask(3, "6"), "6 at 2");
    EXPECT_EQ(ask(3, "5"), "5 at 1.6667");
    EXPECT_EQ(ask(0, "5"), "0 at 1.6667");
    EXPECT_EQ(ask(4, "10,50"), "10.5 at 2.625");
    row->SetField("Quantity", 2);
    row->Update(0);
    EXPECT_EQ(Text(*row, "Amount"), "5.25");
    row->SetField("UnitPrice", "1.9");
    row->Update(0);
    EXPECT_EQ(Text(*row, "UnitPrice") + " " + Text(*row, "Price"), "1.9 2.625");
}

TEST_P(OrderTest, SumsAndTaxesFollowTheRows) {
    Add(1, 10);                    // 8.80 at 20 %
    const auto row = Add(2, 1.5);  // 3.00 at 9 %
    Add(3, 1);                     // 2.63 at 20 %
    const auto sums = [&] {
        std::string shown = Text(*order_->Header(), "Amount") + " " +
                            Text(*order_->Header(), "TaxAmount") + " " +
                            Text(*order_->Header(), "AmountWTax");
        const auto taxes = order_->Header()->Children("GDTax");
        for (std::int64_t i = 1; i <= taxes->Count(); ++i) {
            shown += "; " + Text(*taxes->Item(i), "TaxPercent") + " % of " +
                     Text(*taxes->Item(i), "Base") + ": " + Text(*taxes->Item(i), "Amount");
        }
        return shown;
    };
    EXPECT_EQ(sums(), "14.43 2.56 16.99; 9 % of 3: 0.27; 20 % of 11.43: 2.29");
    row->Delete();
    EXPECT_EQ(sums(), "11.43 2.29 13.72; 20 % of 11.43: 2.29");
    EXPECT_EQ(order_->Header()->Children("SDOrderRow")->Count(), 2);
}

TEST_P(OrderTest, RowsKeepWhatPagesPutIntoThem) {
    const auto first = Add(2, 1);
    const auto second = Add(4, 1);
    EXPECT_TRUE(first->GetField("@RowPrice").IsEmpty());
    first->SetField("@RowPrice", Currency::FromText("2"));
    first->SetField("Explanation", "sinine");
    const auto rows = order_->Rows();
    EXPECT_EQ(rows->Item(1)->GetField("@rowprice"), Value(Currency::FromText("2")));
    EXPECT_EQ(Text(*rows->Item(1), "Explanation"), "sinine");
    EXPECT_LT(first->GetField("ID").ToInteger64(), 0);
    EXPECT_NE(first->GetField("ID"), second->GetField("ID"));
    EXPECT_EQ(Text(*rows->Find("ID=" + Text(*second, "ID")), "IDGRArticle"), "4");
    EXPECT_EQ(rows->Find("IDGRArticle=3"), nullptr);
    EXPECT_EQ(Text(*second, "RowNo"), "2");
}

TEST_P(OrderTest, LinkedFieldsOfAllRowsComeTogether) {
    for (int article = 1; article <= 20; ++article) {
        Add(article, 1);
    }
    const auto rows = order_->Rows();
    Text(*rows->Item(1), "GRArticle.Name");
    Text(*rows->Item(1), "GRArticle.GRTax.TaxPercent");
    watch_->Start();
    EXPECT_EQ(Text(*rows->Item(20), "GRArticle.Code"), "A020");
    EXPECT_EQ(rows->Item(3)->GetField("GRArticle.GRTax.TaxPercent"), Value(20.0));
    EXPECT_EQ(Text(*rows->Item(4), "SDOrder.CompanyName"), "Puit OÜ");
    EXPECT_EQ(watch_->statements(), 0);
    EXPECT_EQ(ErrorOf([&] { rows->Item(1)->GetField("GRArticle.Nothing"); }), kStatementFailed);
    EXPECT_EQ(ErrorOf([&] { rows->Item(1)->GetField("Nothing.Name"); }), kStatementFailed);
}

TEST_P(OrderTest, RowsHaveAnEnd) {
    Add(1, 1);
    const auto rows = order_->Rows();
    while (rows->Count() < 2000) rows->AddRow();
    EXPECT_EQ(ErrorOf([&] { rows->AddRow(); }), base::errors::kInvalidCall);
    EXPECT_EQ(rows->Count(), 2000);
}

TEST_P(OrderTest, RefusedRowValuesLeaveTheRowAsItWas) {
    const auto row = Add(2, 3);
    const struct {
        const char* field;
        Value value;
        int error;
    } rows[] = {
        {"Quantity", "abc", kTypeMismatch},
        {"Quantity", "", kTypeMismatch},
        {"Quantity", -1, kInvalidCall},
        {"Quantity", 1.1e9, kInvalidCall},
        {"IDGRArticle", 46, kInvalidCall},  // in no price list
        {"IDGRArticle", 9999, kInvalidCall},
        {"IDGRArticle", "A001", kTypeMismatch},
        {"Amount", -5, kInvalidCall},
        {"UnitPrice", "x", kTypeMismatch},
        {"Price", 1, kInvalidCall},
        {"Status", 4, kInvalidCall},
        {"DeliveredQuantity", 1, kInvalidCall},
        {"ID", 1, kInvalidCall},
        {"IDSDOrder", 13, kInvalidCall},
        {"Nothing", 1, kStatementFailed},
        {"Explanation", std::string(501, 'x'), kInvalidCall},
    };
    for (const auto& bad : rows) {
        EXPECT_EQ(ErrorOf([&] { row->SetField(bad.field, bad.value); }), bad.error)
            << bad.field << " " << bad.value.ToPlainText();
    }
    row->Update(0);
    EXPECT_EQ(Text(*row, "Quantity") + " " + Text(*row, "Amount") + " " + Text(*row, "IDGRArticle"),
              "3 6 2");
}

TEST_P(OrderTest, HeaderFieldsAreTheCustomersOnly) {
    std::string lengthy;
    for (int i = 0; i < 100; ++i) {
        lengthy += "õ";
    }
    const struct {
        const char* field;
        Value value;
        int error;
        const char* after;
    } rows[] = {
        {"Explanation", "kiire", 0, "kiire"},
        {"CompanyName", lengthy, 0, lengthy.c_str()},
        {"CompanyName", lengthy + "x", kInvalidCall, lengthy.c_str()},
        {"WantedDate", "20.03.2026", 0, "2026-03-20"},
        {"WantedDate", "2026-03-15", 0, "2026-03-15"},
        {"WantedDate", *base::DateTime::FromIso("2026-03-21"), 0, "2026-03-21"},
        {"WantedDate", "14.03.2026", kInvalidCall, "2026-03-21"},
        {"WantedDate", "soon", kTypeMismatch, "2026-03-21"},
        {"WantedDate", "", 0, ""},
        {"IDGRCompany", 1, 0, "1"},
        {"IDGRCompany", "1", 0, "1"},
        {"IDGRCompany", 3, kInvalidCall, "1"},
        {"IDGRCompContPerson", 1, 0, "1"},
        {"IDGRCompContPerson", 2, kInvalidCall, "1"},  // somebody else's
        {"State", 1, kInvalidCall, "0"},
        {"Number", 7, kInvalidCall, ""},
        {"Amount", 7, kInvalidCall, "0"},
        {"NeedsReview", false, kInvalidCall, "0"},
        {"IDGRPriceList", 2, kInvalidCall, "3"},
        {"@note", "x", 0, "x"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(ErrorOf([&] { order_->SetField(row.field, row.value); }), row.error)
            << row.field << " " << row.value.ToPlainText();
        EXPECT_EQ(order_->GetField(row.field).ToPlainText(), row.after) << row.field;
    }
    EXPECT_EQ(ErrorOf([&] { order_->SetField("Nothing", 1); }), kStatementFailed);
}

TEST_P(OrderTest, StoredOrdersOpenWithTheirRows) {
    const auto order = portal_->OpenTable("SDOrder", "ID=11")->First();
    const auto rows = order->Rows();
    ASSERT_EQ(rows->Count(), 3);
    EXPECT_EQ(Text(*order->Header(), "Number") + " " + Text(*order->Header(), "Amount"), "501 30");
    EXPECT_EQ(Text(*rows->Item(2), "Quantity") + " " + Text(*rows->Item(2), "@unitprice"), "2.5 4");
    EXPECT_TRUE(rows->Item(1)->GetField("@RowPrice").IsEmpty());
    const auto fixed = rows->Item(3);
    EXPECT_TRUE(fixed->Status(data::kFixedRow));
    EXPECT_EQ(ErrorOf([&] { fixed->SetField("Quantity", 9); }), kInvalidCall);
    EXPECT_EQ(ErrorOf([&] { fixed->Delete(); }), kInvalidCall);
    EXPECT_EQ(Text(*portal_->OpenTable("SDOrder")->Open(12)->Header(), "State"), "1");
    EXPECT_EQ(ErrorOf([&] { portal_->OpenTable("SDOrder", "State=1")->Open(11); }),
              base::errors::kSubscript);
    EXPECT_EQ(ErrorOf([&] { portal_->OpenTable("SDInvoice"); }), kInvalidCall);
}

}  // namespace
}  // namespace zebtell::erp
