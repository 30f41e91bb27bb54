#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tags/form_values.h"
#include "tests/tags/session.h"

namespace zebtell::tags {
namespace {

using base::Currency;
using base::Value;

void WithTotals(Session& session) {
    session.state.basket.BasketTotal = Currency::FromText("1234.5");
    session.state.basket.BasketQuantity = 7.25;
    session.state.basket.BasketRowCount = 3;
}

void WithBasket(Session& session) {
    session.MakeBasket({0, 0, 0});
    session.state.basket.Basket->SetField("Number", "T<1>");
    session.state.basket_form.RowIndex = 2;
}

void WithPeople(Session& session) {
    auto& company = session.state.company;
    company.ParentLoaded = true;
    company.ParentRecord = fake::MakeRecord({{"Name", "Ema"}});
    company.ContactLoaded = true;
    company.ContactRecord = fake::MakeRecord({{"Name", "Mari"}});
    const auto record = fake::MakeRecord({});
    record->children["EREmployee"] = fake::MakeList({{{"Name", "Jaan"}}, {{"Name", "Teine"}}});
    company.CompanyRecord = record;
}

void Nothing(Session&) {}

TEST(OrderSummaryTags, Table) {
    const struct {
        void (*prepare)(Session&);
        const char* tag;
        const char* contents;
        Answer expected;
    } rows[] = {
        {WithTotals, "ZEB:TellSumma", "", {"1234,5", true}},
        {WithTotals, "zeb:tellsumma", "\u00A00.00 ", {"1234,50", true}},
        {WithTotals, "ZEB:TellKogus", "", {"7,25", true}},
        {WithTotals, "ZEB:TellKogus", "0.0", {"7,3", true}},
        {WithTotals, "ZEB:TellRidu", "", {"3", true}},
        {WithTotals, "ZEB:TellRidu", "000", {"003", true}},
        {Nothing, "ZEB:TellSumma", "", {"0", true}},
        {Nothing, "ZEB:Tellimus", "Number", {"", true}},
        {WithBasket, "ZEB:Tellimus", " Number ", {"T&lt;1&gt;", true}},
        {WithBasket, "ZEB:Tellimus", "Missing", {"", true}},
        {Nothing, "ZEB:Tellimus.Exists", "x", {"", true}},
        {WithBasket, "ZEB:Tellimus.Exists", "x", {"x", true}},
        {Nothing, "ZEB:Tellimus.NotExists", "x", {"x", true}},
        {WithBasket, "ZEB:Tellimus.NotExists", "x", {"", true}},
        {Nothing, "ZEB:Tellimus.Rida", "#", {"", false}},
        {WithBasket, "ZEB:Tellimus.Rida", " # ", {"2", false}},
        {WithBasket, "ZEB:Tellimus.Rida", "Code", {"A2", false}},
        {WithBasket, "ZEB:MuudaKogus", "x", {"Row_2", false}},
        {Nothing, "ZEB:Parent.Exists", "x", {"", false}},
        {WithPeople, "ZEB:Parent.Exists", "x", {"x", false}},
        {Nothing, "ZEB:Parent", "Name", {"", false}},
        {WithPeople, "ZEB:Parent", "Name", {"Ema", false}},
        {Nothing, "ZEB:Contact.Exists", "x", {"", false}},
        {WithPeople, "ZEB:Contact.Exists", "x", {"x", false}},
        {Nothing, "ZEB:Contact", "Name", {"", false}},
        {WithPeople, "ZEB:Contact", "Name", {"Mari", false}},
        {WithPeople, "ZEB:GRCOMPCONTPERSON", "Name", {"Mari", false}},
        {Nothing, "ZEB:Employee", "Name", {"", true}},
        {WithPeople, "ZEB:Employee", "Name", {"Jaan", true}},
        {WithPeople, "ZEB:EREmployee", "Name", {"Jaan", true}},
        {Nothing, "ZEB:HKRida", "x", {"x", false}},
    };
    for (const auto& row : rows) {
        Session session;
        row.prepare(session);
        EXPECT_EQ(session.Ask(OrderSummaryTags, row.tag, row.contents), row.expected)
            << row.tag << " " << row.contents;
    }
}

TEST(OrderSummaryTags, MissingRecordsShowNothing) {
    Session session;
    session.MakeBasket({0});
    session.state.basket_form.RowIndex = 2;
    EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Tellimus.Rida", "Code"), (Answer{"", false}));
    session.state.company.CompanyRecord = fake::MakeRecord({});
    EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Employee", "Name"), (Answer{"", true}));
}

TEST(OrderSummaryTags, PriceQuery) {
    Session session;
    EXPECT_EQ(session.Ask(OrderSummaryTags,
                          "ZEB:PriceQuery",
                          "\r\n select 1 where a &lt;&gt; #F and b in (#A)\r\n"),
              (Answer{"", false}));
    EXPECT_EQ(session.state.templates.PriceQueryText, "select 1 where a <> #F and b in (#A)");
}

TEST(OrdersEnable, Decides) {
    const struct {
        const char* label;
        const char* contents;
        bool before;
        bool expected;
    } rows[] = {
        {"field", " OrdersAllowed ", false, true},
        {"field that is false", "Closed", true, false},
        {"missing field", "Missing", true, true},
        {"null", "Unknown", true, true},
        {"query", "Credit.Open", false, true},
        {"query's field that is false", "Credit.Spent", true, false},
        {"more parts", "Credit.Open.x", false, true},
        {"query's missing field", "Credit.Missing", true, true},
        {"query that the page does not define", "Other.Open", true, true},
        {"nothing", "", true, true},
    };
    for (const auto& row : rows) {
        Session session;
        session.state.company.PartnerRecord =
            fake::MakeRecord({{"Partner.ID", 7},
                              {"Partner.OrdersAllowed", true},
                              {"Partner.Closed", 0},
                              {"Partner.Unknown", Value::Null()}});
        data::clsQuery& query = GetQuery(session.state, "Credit", "Kaubainfo");
        query.Criteria = "IDGRCompany";
        query.RecNo = 2;
        session.application->queries["SELECT * FROM Credit WHERE IDGRCompany=7"] =
            fake::MakeList({{{"Open", 0}, {"Spent", 1}}, {{"Open", 1}, {"Spent", 0}}});
        session.state.templates.OrdersAllowed = row.before;
        EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Orders.Enable", row.contents),
                  (Answer{"", false}))
            << row.label;
        EXPECT_EQ(session.state.templates.OrdersAllowed, row.expected) << row.label;
    }
    Session nobody;
    EXPECT_EQ(nobody.Ask(OrderSummaryTags, "ZEB:Orders.Enable", "OrdersAllowed"),
              (Answer{"", false}));
    EXPECT_FALSE(nobody.state.templates.OrdersAllowed);
}

TEST(RowLoop, ShowsWhatTheFormMayChange) {
    const int fixed = data::kFixedRow;
    const struct {
        const char* label;
        std::vector<int> status;
        const char* expected;
    } rows[] = {
        {"empty", {}, ""},
        {"one row", {0}, "1:A1 "},
        {"rows", {0, 0, 0}, "1:A1 2:A2 3:A3 "},
        {"other status bits", {3, 8}, "1:A1 2:A2 "},
        {"fixed rows between", {0, fixed, fixed, 0, 6, 0}, "1:A1 4:A4 6:A6 "},
        {"fixed rows first", {fixed, 5, 0}, "3:A3 "},
        {"fixed rows last", {0, 0, fixed, fixed}, "1:A1 2:A2 "},
        {"one row, then a fixed one", {0, fixed}, "1:A1 "},
        {"only fixed rows", {fixed, fixed}, ""},
    };
    for (const auto& row : rows) {
        Session session;
        session.MakeBasket(row.status);
        EXPECT_EQ(session.Page("<ZEB:Tellimus.Read><ZEB:Tellimus.Rida>#</ZEB:Tellimus.Rida>:"
                               "<ZEB:Tellimus.Rida>Code</ZEB:Tellimus.Rida> "
                               "</ZEB:Tellimus.Read>"),
                  row.expected)
            << row.label;
    }
}

TEST(RowLoop, OneStep) {
    Session session;
    EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Tellimus.Read", "C"), (Answer{"", false}));
    session.state.basket_form.RowIndex = 4;
    EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Tellimus.Read.Next", "C"), (Answer{"", false}));
    EXPECT_EQ(session.state.basket_form.RowIndex, 5);

    session.MakeBasket({0, data::kFixedRow, 0, 0});
    const Answer more = {"C<ZEB:Tellimus.Read.Next>C</ZEB:Tellimus.Read.Next>", false};
    EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Tellimus.Read", "C"), more);
    EXPECT_EQ(session.state.basket_form.RowIndex, 1);
    EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Tellimus.Read.Next", "C"), more);
    EXPECT_EQ(session.state.basket_form.RowIndex, 3);
    EXPECT_EQ(session.Ask(OrderSummaryTags, "ZEB:Tellimus.Read.Next", "C"), (Answer{"C", false}));
    EXPECT_EQ(session.state.basket_form.RowIndex, 4);
}

}  // namespace
}  // namespace zebtell::tags
