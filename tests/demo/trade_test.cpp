#include <gtest/gtest.h>

#include "tests/demo/demo_fixture.h"

namespace zebtell::demo {
namespace {

class TradeTest : public DemoCompanyTest {};

struct Rule {
    const char* what;
    const char* offenders;  // selects what breaks the rule
};

constexpr Rule kRules[] = {
    {"foreign keys lead somewhere", "pragma foreign_key_check"},
    {"what is delivered of an order row is on its delivery notes",
     "select r.ID from SDOrderRow r where r.DeliveredQuantity <> (select "
     "ifnull(sum(d.Quantity), 0) from DDStoreDRow d where d.IDSDOrderRow = r.ID)"},
    {"nothing is delivered twice", "select ID from SDOrderRow where DeliveredQuantity > Quantity"},
    {"an invoice row bills its delivery row",
     "select i.ID from SDInvoiceRow i join DDStoreDRow d on d.ID = i.IDDDStoreDRow where "
     "i.Quantity <> d.Quantity or i.Price <> d.Price or i.IDGRArticle <> d.IDGRArticle"},
    {"the state of an order follows from its rows",
     "select o.ID, o.State, sum(DeliveredQuantity) as done, sum(Quantity) as all_of_it from "
     "SDOrder o join SDOrderRow r on r.IDSDOrder = o.ID group by o.ID having (State = 3) <> "
     "(done = all_of_it) or (State = 2) <> (done > 0 and done < all_of_it)"},
    {"an invoice is paid when its state says so",
     "select ID from SDInvoice where (State = 2) <> (PaidAmount = AmountWTax) or PaidAmount < 0 "
     "or PaidAmount > AmountWTax"},
    {"a delivery note follows one order of the same company, not earlier than it",
     "select d.ID from SDConsignmD d left join GDocRel x on x.IDGDocument = d.ID left join "
     "SDOrder o on o.ID = x.IDSrcGDocument where o.ID is null or o.DocDate > d.DocDate or "
     "o.IDGRCompany <> d.IDGRCompany"},
    {"a document follows one other at most",
     "select IDGDocument from GDocRel group by IDGDocument having count(*) > 1"},
    {"an invoice follows one delivery note of the same company, not earlier than it",
     "select i.ID from SDInvoice i left join GDocRel x on x.IDGDocument = i.ID left join "
     "SDConsignmD d on d.ID = x.IDSrcGDocument where d.ID is null or d.DocDate > i.DocDate or "
     "d.IDGRCompany <> i.IDGRCompany"},
    {"a document's date is the day it was made and a workday",
     "select d.ID from GDocument d join (select ID, DocDate from SDOrder union all select ID, "
     "DocDate from SDConsignmD union all select ID, DocDate from SDInvoice) x on x.ID = d.ID "
     "where date(Created) <> DocDate or strftime('%w', DocDate) in ('0', '6')"},
    {"numbers rise with the dates",
     "select a.ID from SDOrder a join SDOrder b on b.Number = a.Number + 1 where "
     "b.DocDate < a.DocDate"},
    {"articles that have no price are not bought",
     "select ID from SDOrderRow where UnitPrice = 0 or Amount = 0"},
    {"a row's price is its list price with the percentage",
     "select r.ID from SDOrderRow r join SDOrder o on o.ID = r.IDSDOrder left join SQPriceList5 p "
     "on p.IDGRPriceList = o.IDGRPriceList and p.IDGRArticle = r.IDGRArticle where r.Status = 0 "
     "and ifnull(abs(p.Price * (100 + r.PriceCut) / 100 - r.Price), 1) > 0.0051"},
    {"every company but the blocked ones ordered in the newest half year",
     "select ID from GRCompany c where OrdersAllowed <> exists (select 1 from SDOrder o where "
     "o.IDGRCompany = c.ID and DocDate > '2026-05-20')"},
};

TEST_F(TradeTest, KeepsItsRules) {
    for (const Rule& rule : kRules) {
        const auto offenders = sql().Rows(rule.offenders);
        EXPECT_EQ(offenders.size(), 0U)
            << rule.what << "; for example " << (offenders.empty() ? "" : offenders[0][0]);
    }
    EXPECT_EQ(sql().Text("pragma integrity_check"), "ok");
}

TEST_F(TradeTest, HasEverythingThatPagesShow) {
    EXPECT_EQ(sql().Number("select count(*) from SDOrderRow where Status = 0"), 15'000);
    EXPECT_GT(sql().Number("select count(*) from SDOrderRow where Status = 4"), 50);
    EXPECT_EQ(sql().Text("select min(State) || max(State) from SDOrder"), "03");
    EXPECT_EQ(sql().Text("select max(DocDate) from SDOrder"), "2026-11-20");
    EXPECT_LT(sql().Text("select min(DocDate) from SDOrder"), "2024-12-01");
    EXPECT_GT(sql().Number("select count(*) from SDInvoice where PaidAmount < AmountWTax and "
                           "DueDate < '2026-11-20'"),
              20);
    EXPECT_GT(sql().Number("select count(*) from SDInvoice where PaidAmount > 0 and "
                           "PaidAmount < AmountWTax"),
              20);
}

TEST_F(TradeTest, ShowsTheKnownCustomersSomethingNew) {
    for (const char* user : {"mari", "janis"}) {
        const std::string of_user =
            std::string(" where IDGRCompany = (select IDPartner from SYUser where Name = '") +
            user + "')";
        EXPECT_GE(sql().Number("select count(*) from SDOrder" + of_user + " and State = 0"), 1)
            << user;
        const std::int64_t bought = sql().Number(
            "select count(distinct IDGRArticle) from SDOrderRow where Status = 0 and IDSDOrder in "
            "(select ID from SDOrder" +
            of_user + ")");
        EXPECT_GE(bought, 20) << user;
        EXPECT_LE(bought, 80) << user;
    }
}

}  // namespace
}  // namespace zebtell::demo
