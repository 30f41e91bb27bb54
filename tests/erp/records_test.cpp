#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "data/price_query_text.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

using base::Value;

class RecordsTest : public PortalTest {};
INSTANTIATE_TEST_SUITE_P(Databases,
                         RecordsTest,
                         testing::ValuesIn(DatabaseKinds()),
                         [](const auto& test) { return test.param.name; });

TEST_P(RecordsTest, FieldsHaveTheTypesOfTheirColumns) {
    const auto portal = LogOn();
    const auto order = portal->Load("SDOrder", 11);
    const auto row = order->Children("SDOrderRow")->Item(2);
    EXPECT_EQ(order->GetField("number"), Value(501));
    EXPECT_EQ(order->GetField("Amount"), Value(base::Currency::FromText("30")));
    EXPECT_EQ(order->GetField("DocDate"), Value(*base::DateTime::FromIso("2026-01-05")));
    EXPECT_EQ(order->GetField("NeedsReview"), Value(false));
    EXPECT_TRUE(order->GetField("WantedDate").IsNull());
    EXPECT_EQ(row->GetField("Quantity"), Value(2.5));
    EXPECT_EQ(portal->Load("GDocument", 11)->GetField("Created"),
              Value(*base::DateTime::FromIso("2026-01-05 09:30:00")));
    EXPECT_EQ(portal->Load("GRCompany", 1)->GetField("Name"), Value("Puit OÜ"));
}

TEST_P(RecordsTest, PathsFollowLinks) {
    const auto portal = LogOn();
    EXPECT_EQ(Text(*user_, "Partner.Name"), "Puit OÜ");
    EXPECT_EQ(Text(*user_, "partner.PARENT.name"), "Ema AS");
    EXPECT_EQ(user_->GetField("Partner.PriceCut"), Value(-10.0));
    EXPECT_EQ(Text(*user_, "GRCompContPerson.Position"), "ostja");
    EXPECT_TRUE(user_->GetField("Partner.SettlCompany.Name").IsNull());
    const auto line = portal->Load("GRPriceListRel", 103);
    EXPECT_EQ(line->GetField("GRArticle.GRTax.TaxPercent"), Value(20.0));
    for (const char* name : {"Nothing", "GRArticle.Nothing", "Nothing.Name", "PasswordHash"}) {
        EXPECT_EQ(ErrorOf([&] { user_->GetField(name); }), base::errors::kStatementFailed) << name;
    }
    EXPECT_TRUE(line->GetField("@RowPrice").IsEmpty());
    EXPECT_EQ(ErrorOf([&] { line->SetField("Price", 1); }), base::errors::kInvalidCall);
}

TEST_P(RecordsTest, ChildrenLinkToTheRecordOrAreLinkedFromIt) {
    const auto portal = LogOn();
    const auto order = portal->OpenList("SDOrder", "ID=11", "")->Item(1);
    const auto rows = order->Children("SDOrderRow");
    ASSERT_EQ(rows->Count(), 3);
    EXPECT_EQ(Text(*rows->Item(1), "GRArticle.Code") + Text(*rows->Item(2), "GRArticle.Code"),
              "A008A004");
    EXPECT_FALSE(rows->Item(1)->Status(data::kFixedRow));
    EXPECT_TRUE(rows->Item(3)->Status(data::kFixedRow));
    EXPECT_EQ(order->Children("GDTax")->Count(), 1);
    const auto company = portal->Load("GRCompany", 1);
    EXPECT_EQ(Text(*company->Children("EREmployee")->Item(1), "Name"), "Rein");
    EXPECT_EQ(portal->Load("GRCompany", 2)->Children("EREmployee")->Count(), 0);
    EXPECT_EQ(ErrorOf([&] { company->Children("GRTax"); }), base::errors::kStatementFailed);
    EXPECT_EQ(ErrorOf([&] { company->Children("Nothing"); }), base::errors::kNoSuchTable);
}

TEST_P(RecordsTest, WithoutAListOfItsOwnACompanySeesTheDefaultOnes) {
    EXPECT_EQ(LogOn()->Load("GRPriceListRel", 203), nullptr);
    const auto portal = LogOn("Õie");
    EXPECT_EQ(portal->OpenList("GRPriceListRel", "", "")->Count(), 45);
    EXPECT_NE(portal->Load("GRPriceListRel", 203), nullptr);
}

TEST_P(RecordsTest, QueriesGiveRecordsOfTheirColumns) {
    const auto portal = LogOn();
    const auto list = portal->OpenQuery(
        "select r.*, r.Quantity * 2 as doubled from SDOrderRow r order by r.ID", 0, 0);
    ASSERT_EQ(list->Count(), 4);
    const auto row = list->Find("id=2");
    ASSERT_NE(row, nullptr);
    EXPECT_EQ(row->GetField("Doubled"), Value(4.0));
    EXPECT_EQ(row->GetField("Price"), Value(base::Currency::FromText("8")));
    EXPECT_EQ(list->Find("IDGRArticle=99"), nullptr);
    // The linked fields of all rows come together.
    EXPECT_EQ(Text(*list->Item(1), "GRArticle.GRTax.Name"), "9 %");
    watch_->Start();
    EXPECT_EQ(Text(*list->Item(2), "GRArticle.GRTax.Name"), "9 %");
    EXPECT_EQ(watch_->statements(), 0);
    EXPECT_EQ(ErrorOf([&] { row->GetField("Nothing"); }), base::errors::kStatementFailed);
    EXPECT_EQ(ErrorOf([&] { row->GetField("Nothing.Name"); }), base::errors::kStatementFailed);
    EXPECT_EQ(ErrorOf([&] { list->Item(5); }), base::errors::kSubscript);
    EXPECT_EQ(ErrorOf([&] { list->AddRow(); }), base::errors::kInvalidCall);
}

TEST_P(RecordsTest, PlainQueriesHaveChildrenAndPathsOfTheirTable) {
    const auto portal = LogOn();
    const auto user = portal->OpenQuery("SELECT *\r\nFROM SYUser", 0, 0)->Item(1);
    EXPECT_EQ(Text(*user, "Partner.Name"), "Puit OÜ");
    const auto order = portal->OpenQuery("SELECT * FROM SDOrder WHERE ID=11", 0, 0)->Item(1);
    EXPECT_EQ(order->Children("SDOrderRow")->Count(), 3);
}

TEST_P(RecordsTest, TheCustomerPriceQueryGivesOwnPrices) {
    const auto portal = LogOn();
    std::string text = data::DefaultPriceQueryText();
    text = base::ReplacedNoCase(text, "#P", "1");
    text = base::ReplacedNoCase(text, "#H", "3");
    const auto prices = portal->OpenQuery(base::ReplacedNoCase(text, "#A", "1,2,3,5"), 0, 0);
    EXPECT_EQ(prices->Count(), 4);
    EXPECT_EQ(prices->Find("idgrarticle=3")->GetField("FinalPrice"), Value(2.63));
    EXPECT_EQ(prices->Find("idgrarticle=2")->GetField("FinalPrice").ToDouble(), 2.0);
    EXPECT_EQ(prices->Find("idgrarticle=1")->GetField("PriceCut").ToDouble(), -12.5);
}

TEST_P(RecordsTest, TooManyRowsAreRefused) {
    const auto portal = LogOn();
    EXPECT_EQ(ErrorOf([&] {
                  portal->OpenQuery("select a.ID from GRArticle a, GRArticle b, GRArticle c", 0, 0);
              }),
              base::errors::kStatementFailed);
}

}  // namespace
}  // namespace zebtell::erp
