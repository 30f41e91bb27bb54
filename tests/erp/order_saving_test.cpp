#include <gmock/gmock.h>

#include <thread>

#include "base/runtime_error.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

using base::errors::kInvalidCall;
using base::errors::kUnspecified;

class OrderSavingTest : public PortalTest {
  protected:
    void SetUp() override { portal_ = LogOn(); }

    std::shared_ptr<data::Document> NewOrder() {
        auto order = portal_->OpenTable("SDOrder")->Open(0);
        Add(*order, 3, 2);
        Add(*order, 2, 1.5);
        Add(*order, 4, 0);
        return order;
    }
    static std::shared_ptr<data::Record> Add(data::Document& order, int article, double quantity) {
        auto row = order.Rows()->AddRow();
        row->SetField("IDGRArticle", article);
        row->SetField("Quantity", quantity);
        row->Update(0);
        return row;
    }
    // The stored orders from a number on, whole.
    std::string Stored(int number = 504) const {
        const std::string from = " from SDOrder where Number >= " + std::to_string(number);
        const std::string rows = " where IDSDOrder in (select ID" + from + ")";
        return "orders " +
               company_->Show(
                   "select Number, State, DocDate, IDGRCompany, IDGRPriceList, Amount,"
                   " TaxAmount, AmountWTax, NeedsReview, Explanation" +
                   from + " order by Number") +
               " rows " +
               company_->Show(
                   "select RowNo, IDGRArticle, Quantity, Price, Amount, TaxPercent,"
                   " Status from SDOrderRow" +
                   rows + " order by IDSDOrder, RowNo") +
               " taxes " +
               company_->Show(
                   "select TaxPercent, Base, Amount from GDTax where IDGDocument in"
                   " (select ID" +
                   from + ") order by IDGDocument, TaxPercent");
    }
    std::string Documents() const { return company_->Show("select count(*) from GDocument"); }

    static constexpr const char* kNewOrder =
        "orders 504 0 2026-03-15 1 3 8.26 1.32 9.58 0 ; "
        "rows 1 3 2 2.63 5.26 20 0;2 2 1.5 2 3 9 0; "
        "taxes 9 3 0.27;20 5.26 1.05;";
    static constexpr const char* kNothing = "orders  rows  taxes ";

    std::unique_ptr<data::DataApplication> portal_;
};
INSTANTIATE_TEST_SUITE_P(Databases,
                         OrderSavingTest,
                         testing::ValuesIn(DatabaseKinds()),
                         [](const auto& test) { return test.param.name; });

TEST_P(OrderSavingTest, AnOrderIsStoredOnce) {
    const auto order = NewOrder();
    EXPECT_EQ(Stored(), kNothing);
    order->Save();
    EXPECT_EQ(Stored(), kNewOrder);
    EXPECT_EQ(Text(*order->Header(), "Number"), "504");
    const std::int64_t id = order->GetField("ID").ToInteger64();
    EXPECT_NE(portal_->Load("SDOrder", id), nullptr);
    EXPECT_GT(order->Rows()->Item(1)->GetField("ID").ToInteger64(), 0);
    EXPECT_LT(order->Rows()->Item(3)->GetField("ID").ToInteger64(), 0);
    order->Save();
    EXPECT_EQ(Stored(), kNewOrder);
    EXPECT_EQ(
        company_->Show("select Kind, Created from GDocument where ID = " + std::to_string(id)),
        "SDOrder 2026-03-15 10:00:00;");
}

TEST_P(OrderSavingTest, ChangesOfAStoredOrderAreStored) {
    const auto order = portal_->OpenTable("SDOrder", "ID=11")->First();
    order->SetField("Explanation", "hiljem");
    const auto rows = order->Rows();
    rows->Item(1)->SetField("Quantity", 0);
    rows->Item(1)->Update(0);
    rows->Item(2)->SetField("Quantity", 1);
    rows->Item(2)->Update(0);
    Add(*order, 6, 1);
    order->Save();
    EXPECT_THAT(Stored(501),
                testing::StartsWith("orders 501 0 2026-01-05 1 3 14 1.26 15.26 0 hiljem;"));
    EXPECT_EQ(company_->Show("select ID, RowNo, IDGRArticle, Quantity, Price, Amount, Status "
                             "from SDOrderRow where IDSDOrder = 11 order by RowNo"),
              "1 2 4 1 4 4 0;3 3 2 1 4 4 4;6 4 6 1 6 6 0;");
    // Once more, the same document: a row that was not stored before is now.
    rows->Item(1)->SetField("Quantity", 2);
    rows->Item(1)->Update(0);
    order->Save();
    EXPECT_EQ(company_->Show("select Amount, Explanation from SDOrder where ID = 11"),
              "30 hiljem;");
    EXPECT_EQ(company_->Show("select count(*), sum(Amount) from SDOrderRow where IDSDOrder = 11"),
              "4 30;");
}

TEST_P(OrderSavingTest, WhatStaffHaveBegunOrChangedIsRefused) {
    const std::string before = Stored(501);
    const auto begun = portal_->OpenTable("SDOrder")->Open(12);
    begun->SetField("Explanation", "x");
    EXPECT_EQ(ErrorOf([&] { begun->Save(); }), kInvalidCall);
    const auto order = portal_->OpenTable("SDOrder")->Open(11);
    order->SetField("Explanation", "x");
    company_->Run("update SDOrderRow set Quantity = 3 where ID = 2");
    EXPECT_EQ(ErrorOf([&] { order->Save(); }), kInvalidCall);
    company_->Run("update SDOrderRow set Quantity = 2 where ID = 2");
    company_->Run("update SDOrder set State = 2 where ID = 11");
    EXPECT_EQ(ErrorOf([&] { order->Save(); }), kInvalidCall);
    company_->Run("update SDOrder set State = 0 where ID = 11");
    EXPECT_EQ(Stored(501), before);
    order->Save();
    EXPECT_EQ(company_->Show("select Explanation from SDOrder where ID = 11"), "x;");
}

TEST_P(OrderSavingTest, OrdersWithoutRowsAreRefused) {
    const auto order = portal_->OpenTable("SDOrder")->Open(0);
    EXPECT_EQ(ErrorOf([&] { order->Save(); }), kInvalidCall);
    order->Rows()->AddRow();
    Add(*order, 2, 0);
    EXPECT_EQ(ErrorOf([&] { order->Save(); }), kInvalidCall);
    EXPECT_EQ(Documents(), "3;");
}

TEST_P(OrderSavingTest, PricesBelowTheOwnAreMarkedForReview) {
    const auto review = [&](const char* amount, const char* sql, const char* unit_price = "") {
        const auto order = portal_->OpenTable("SDOrder")->Open(0);
        const auto row = Add(*order, 3, 2);  // at 2.63
        if (*amount != '\0') {
            row->SetField("Amount", amount);
            row->Update(0);
        }
        if (*unit_price != '\0') {
            row->SetField("UnitPrice", unit_price);
            row->Update(0);
        }
        if (*sql != '\0') {
            company_->Run(sql);
        }
        order->Save();
        return company_->Show(
            "select o.NeedsReview, o.Amount, r.ReviewPrice, v.Missing from SDOrder o"
            " join SDOrderRow r on r.IDSDOrder = o.ID left join SDOrderReview v on v.ID = r.ID"
            " where o.ID = (select max(ID) from SDOrder)");
    };
    EXPECT_EQ(review("", ""), "0 5.26  ;");
    EXPECT_EQ(review("5.25", ""), "1 5.25 2.63 0.01;");
    EXPECT_EQ(review("9", ""), "0 9  ;");
    EXPECT_EQ(review("", "", "2.63"), "0 5.26  ;");
    EXPECT_EQ(review("", "", "2.62"), "1 5.26 2.63 0;");
    EXPECT_EQ(review("", "update GRPriceListRel set Price = 3.10 where ID = 103"),
              "1 5.26 2.71 0.16;");
    EXPECT_EQ(review("", "delete from GRPriceListRel where ID = 103"), "1 5.42 0 -5.42;");
}

TEST_P(OrderSavingTest, AGuestSeesWhatHeHasStored) {
    portal_ = LogOn("WebGuest");
    const auto order = portal_->OpenTable("SDOrder")->Open(0);
    Add(*order, 1, 1);
    order->Save();
    const std::int64_t id = order->GetField("ID").ToInteger64();
    const auto header = portal_->OpenList("SDOrder", "ID=" + std::to_string(id), "")->Item(1);
    EXPECT_EQ(header->Children("SDOrderRow")->Count(), 1);
    EXPECT_EQ(Text(*header->Children("GDTax")->Item(1), "Amount"), "0.4");
    order->SetField("Explanation", "veel");
    order->Save();
    EXPECT_EQ(company_->Show("select Explanation from SDOrder where Number = 504"), "veel;");
    const auto other = LogOn("WebGuest");
    EXPECT_EQ(other->Load("SDOrder", id), nullptr);
    EXPECT_EQ(other->OpenList("SDOrderRow", "", "")->Count(), 0);
}

// The n-th statement fails, for every n that there is.
TEST_P(OrderSavingTest, AFailedSaveStoresNothingAndMayBeRepeated) {
    int n = 1;
    for (; n < 100; ++n) {
        const auto order = NewOrder();
        watch_->FailAt(n);
        const int error = ErrorOf([&] { order->Save(); });
        watch_->FailAt(0);
        if (error == 0) {
            break;
        }
        ASSERT_EQ(error, kUnspecified) << n;
        ASSERT_EQ(Stored(), kNothing) << n;
        ASSERT_EQ(Documents(), "3;") << n;
        ASSERT_EQ(Text(*order->Header(), "ID") + " " + Text(*order->Header(), "Amount"), "0 8.26");
        ASSERT_EQ(order->Rows()->Count(), 3);
        order->Save();
        ASSERT_EQ(Stored(), kNewOrder) << n;
        company_->Run("delete from GDTax where IDGDocument > 13");
        company_->Run("delete from SDOrderRow where IDSDOrder > 13");
        company_->Run("delete from SDOrder where ID > 13");
        company_->Run("delete from GDocument where ID > 13");
    }
    EXPECT_GT(n, 10);
    EXPECT_LT(n, 100);
}

TEST_P(OrderSavingTest, ALostAnswerDoesNotStoreTwice) {
    const auto order = NewOrder();
    watch_->LoseAnswer();
    EXPECT_EQ(ErrorOf([&] { order->Save(); }), kUnspecified);
    EXPECT_EQ(order->GetField("ID").ToInteger64(), 0);
    order->Save();
    EXPECT_EQ(Stored(), kNewOrder);
    EXPECT_EQ(Text(*order->Header(), "Number"), "504");
    EXPECT_GT(order->GetField("ID").ToInteger64(), 13);
}

TEST_P(OrderSavingTest, ADoubleSubmitStoresOnce) {
    const auto order = NewOrder();
    std::atomic<int> failures = 0;
    const auto save = [&] { failures += ErrorOf([&] { order->Save(); }) != 0; };
    std::thread first(save);
    std::thread second(save);
    first.join();
    second.join();
    EXPECT_EQ(failures, 0);
    EXPECT_EQ(Stored(), kNewOrder);
}

TEST_P(OrderSavingTest, ManySessionsStoreOrdersAtTheSameTime) {
    constexpr int kSessions = 4;
    constexpr int kOrders = 5;
    std::vector<std::thread> threads;
    std::atomic<int> failures = 0;
    for (int session = 0; session < kSessions; ++session) {
        threads.emplace_back([&] {
            failures += ErrorOf([&] {
                            const auto portal = databases_->NewApplication();
                            portal->Initialise("ZEBTell", "WEBUser", "WEBGuest", "");
                            portal->Logon(company_->type(), company_->path(), "mari", "sala");
                            for (int i = 0; i < kOrders; ++i) {
                                const auto order = portal->OpenTable("SDOrder")->Open(0);
                                Add(*order, i + 1, 1);
                                order->Save();
                                const auto list = portal->OpenList("SDOrderRow", "", "ID desc");
                                Text(*list->Item(1), "GRArticle.Name");
                                list->Find("IDGRArticle=3");
                            }
                        }) != 0;
        });
    }
    for (auto& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(failures, 0);
    EXPECT_EQ(company_->Show("select count(*), count(distinct Number), max(Number) from SDOrder"),
              "23 23 523;");
}

}  // namespace
}  // namespace zebtell::erp
