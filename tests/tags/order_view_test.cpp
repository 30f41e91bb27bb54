#include "tags/order_view.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/tags/session.h"

namespace zebtell::tags {
namespace {

using base::Currency;
using base::Value;

// A session whose database holds one order with these rows ("Code" A, B, ...) and tax lines.
class OrderView : public testing::Test {
  protected:
    OrderView() {
        session_.runtime.url_for = [](std::string_view page, std::string_view event) {
            return "/" + std::string(page) + "/" + std::string(event);
        };
        Store({"A", "B"}, {24, 9});
    }

    void Store(const std::vector<const char*>& codes, const std::vector<int>& taxes) {
        auto rows = std::make_shared<fake::List>();
        for (const char* code : codes) {
            rows->rows.push_back(
                fake::MakeRecord({{"Code", code}, {"Quantity", 2.5}, {"Price", Value::Null()}}));
        }
        auto lines = std::make_shared<fake::List>();
        for (const int percent : taxes) {
            lines->rows.push_back(fake::MakeRecord({{"TaxPercent", percent}, {"Base", 1}}));
        }
        header_ = fake::MakeRecord({{"ID", 17},
                                    {"State", 0},
                                    {"Amount", Currency::FromText("1234.5")},
                                    {"CompanyName", "<Mets> & 'Mari'"}});
        header_->children = {{"SDOrderRow", rows}, {"GDTax", lines}};
        auto list = std::make_shared<fake::List>();
        list->rows.push_back(header_);
        session_.application->lists["SDOrder|ID=17"] = list;
        session_.application->lists["SDOrder|ID=18"] = std::make_shared<fake::List>();
    }

    void Read(const char* filter = "ID_17") {
        session_.state.confirmation.ShownOrderFilter = filter;
        ReadShownOrder(session_.state);
    }

    std::string Shown(const std::string& text) {
        RewindOrderView(session_.state);
        return session_.Page(text, &OrderViewTagTable());
    }

    Session session_;
    std::shared_ptr<fake::Record> header_;
};

TEST_F(OrderView, NothingToShow) {
    EXPECT_EQ(Shown("<ZEB:SDOrder>Number</ZEB:SDOrder><ZEB:SDOrder.Exists>x</ZEB:SDOrder.Exists>"
                    "<ZEB:SDOrder.NotExists>none</ZEB:SDOrder.NotExists><ZEB:SDOrderLink/>"
                    "<ZEB:SDOrder.Open>x</ZEB:SDOrder.Open><ZEB:TellRida>x</ZEB:TellRida>"
                    "<ZEB:MaksuRida>x</ZEB:MaksuRida><ZEB:SDOrderRow>Code</ZEB:SDOrderRow>"
                    "<ZEB:GDTax>Base</ZEB:GDTax>"),
              "&nbsp;none&nbsp;&nbsp;");
}

TEST_F(OrderView, HeaderFields) {
    Read();
    const std::pair<const char*, const char*> kRows[] = {
        {"amount", "1234,50"},
        {"Amount;0.0", "1234,5"},
        {"CompanyName", "&lt;Mets&gt; & 'Mari'"},
        {"CompanyName;zeb:attr", "&lt;Mets&gt; &amp; &#39;Mari&#39;"},
        {"Missing", ""},
    };
    for (const auto& [reference, expected] : kRows) {
        EXPECT_EQ(Shown("<ZEB:SDOrder>" + std::string(reference) + "</ZEB:SDOrder>"), expected)
            << reference;
    }
    EXPECT_EQ(Shown("<ZEB:SDOrderLink/>"), "/Tellimus/ID_17");
}

TEST_F(OrderView, RowsAndTaxLinesOfAnyNumber) {
    const struct {
        std::vector<const char*> codes;
        std::vector<int> taxes;
        const char* expected;
    } rows[] = {
        {{}, {}, "||"},
        {{"A"}, {24}, "(A 2,50)|[24 1,00]|"},
        {{"A", "B", "C"}, {24, 9}, "(A 2,50)(B 2,50)(C 2,50)|[24 1,00][9 1,00]|"},
    };
    for (const auto& row : rows) {
        Store(row.codes, row.taxes);
        session_.state.documents.ShownOrder = {};
        Read();
        const char* text =
            "<ZEB:TellRida>(<ZEB:SDOrderRow>Code</ZEB:SDOrderRow> "
            "<ZEB:SDOrderRow>Quantity</ZEB:SDOrderRow>)</ZEB:TellRida>|"
            "<ZEB:MaksuRida>[<ZEB:GDTax>TaxPercent</ZEB:GDTax> <ZEB:GDTax>Base</ZEB:GDTax>]"
            "</ZEB:MaksuRida>|";
        EXPECT_EQ(Shown(text), row.expected);
        EXPECT_EQ(Shown(text), row.expected) << "shown again";
    }
}

TEST_F(OrderView, OpenWhileStaffHaveNotBegun) {
    Read();
    const char* text = "<ZEB:SDOrder.Open>change</ZEB:SDOrder.Open>";
    EXPECT_EQ(Shown(text), "change");
    header_->SetField("State", 1);
    EXPECT_EQ(Shown(text), "");
    header_->SetField("State", Value::Null());
    EXPECT_EQ(Shown(text), "");
}

TEST_F(OrderView, JustSavedOnce) {
    session_.state.confirmation.OrderJustSaved = true;
    EXPECT_EQ(Shown("<ZEB:JustSaved>thanks</ZEB:JustSaved><ZEB:JustSaved>x</ZEB:JustSaved>"),
              "thanks");
}

TEST_F(OrderView, ReadsOnceAndKeepsWhatIsShownWhenThereIsNoSuchOrder) {
    Read();
    Read();
    EXPECT_THAT(session_.application->asked, testing::ElementsAre("OpenList SDOrder|ID=17|"));
    session_.state.documents.ShownOrder = {};
    EXPECT_THROW(Read("ID_18"), base::RuntimeError);
    EXPECT_EQ(session_.state.documents.ShownOrder.Header, nullptr);
}

}  // namespace
}  // namespace zebtell::tags
