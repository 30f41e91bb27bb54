#include "catalogue/price_list.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "catalogue/kaubainfo_tags.h"
#include "tests/tags/session.h"

namespace zebtell::catalogue {
namespace {

using base::Currency;

// A session whose list is of `rows` price lines; article n has the ID 100 + n and costs n.
class PriceListTest : public ::testing::Test {
  protected:
    void MakeList(int rows) {
        auto lines = std::make_shared<fake::List>();
        auto prices = std::make_shared<fake::List>();
        for (int n = 1; n <= rows; ++n) {
            lines->rows.push_back(fake::MakeRecord(
                {{"ID", n}, {"IDGRArticle", 100 + n}, {"Price", Currency::FromDouble(n)}}));
            prices->rows.push_back(fake::MakeRecord({{"idgrarticle", 100 + n},
                                                     {"FinalPrice", Currency::FromDouble(n * 0.9)},
                                                     {"PriceCut", -10.0}}));
        }
        session.application->lists["GRPriceListRel"] = lines;
        session.application->any_query = prices;
        OpenList(session.state, "criterion");
    }
    std::string Page(const std::string& text) { return session.Page(text, &KaubainfoTagTable()); }
    std::string Rows() {
        RewindPage(session.state.catalogue);
        return Page("<ZEB:HKRida><ZEB:LisaKogus/> </ZEB:HKRida>");
    }

    tags::Session session;
    host::CatalogueState& catalogue = session.state.catalogue;
};

TEST_F(PriceListTest, PagesOfAList) {
    struct Case {
        const char* label;
        int rows;
        std::int16_t page_length;
        const char* parts;      // which parts of the paging bar are shown
        const char* last_page;  // rows of the last page
    };
    const Case cases[] = {
        // Page 1 of no pages is neither the last one nor before it.
        {"empty list", 0, 20, "1/0 first single", ""},
        {"one page", 3, 20, "1/1 first last single", "ID_1 ID_2 ID_3 "},
        {"full page", 4, 4, "1/1 first last single", "ID_1 ID_2 ID_3 ID_4 "},
        {"last page shorter", 9, 4, "1/3 first notlast multiple", "ID_9 "},
        {"no paging", 3, 0, "1/1 first last single", "ID_1 ID_2 ID_3 "},
    };
    for (const Case& c : cases) {
        catalogue = {};
        catalogue.PageLength = c.page_length;
        MakeList(c.rows);
        EXPECT_EQ(Page("<ZEB:Pagenum/>/<ZEB:Pagecount/><ZEB:Pages.First> first</ZEB:Pages.First>"
                       "<ZEB:Pages.NotFirst> notfirst</ZEB:Pages.NotFirst>"
                       "<ZEB:Pages.Last> last</ZEB:Pages.Last>"
                       "<ZEB:Pages.NotLast> notlast</ZEB:Pages.NotLast>"
                       "<ZEB:Pages.Single> single</ZEB:Pages.Single>"
                       "<ZEB:Pages.Multiple> multiple</ZEB:Pages.Multiple>"),
                  c.parts)
            << c.label;
        TurnPage(catalogue, "LastPage");
        EXPECT_EQ(Rows(), c.last_page) << c.label;
    }
}

TEST_F(PriceListTest, CommandsTurnWithinTheList) {
    catalogue.PageLength = 2;
    MakeList(5);
    struct Case {
        const char* command;
        int page;
    };
    const Case cases[] = {{"PrevPage", 1},
                          {"NextPage", 2},
                          {"nextpage", 3},
                          {"NextPage", 3},
                          {"Nonsense", 3},
                          {"PrevPage", 2},
                          {"LastPage", 3},
                          {"FirstPage", 1}};
    for (const Case& c : cases) {
        catalogue.ListFresh = false;
        TurnPage(catalogue, c.command);
        EXPECT_EQ(catalogue.PageNumber, c.page) << c.command;
        EXPECT_EQ(catalogue.RowCursor, (c.page - 1) * 2 + 1) << c.command;
        EXPECT_TRUE(catalogue.ListFresh) << c.command;
    }
}

TEST_F(PriceListTest, PageLengthThatIsNoNumberShowsAll) {
    catalogue.PageLength = 2;
    EXPECT_EQ(Page("<ZEB:Pagelen>kakskümmend</ZEB:Pagelen>"), "");
    MakeList(5);
    EXPECT_EQ(Rows(), "ID_1 ID_2 ID_3 ID_4 ID_5 ");
}

TEST_F(PriceListTest, AListThatFailsLeavesTheOneThatWas) {
    catalogue.PageLength = 2;
    MakeList(5);
    TurnPage(catalogue, "NextPage");
    session.application->error = base::RuntimeError(base::errors::kStatementFailed);
    EXPECT_THROW(OpenList(session.state, "bad"), base::RuntimeError);
    session.application->error.reset();
    EXPECT_EQ(Rows(), "ID_3 ID_4 ");
}

TEST_F(PriceListTest, MoreRowsThanTheCountHoldsAreAnError) {
    auto many = std::make_shared<fake::List>();
    many->rows.resize(32768);
    session.application->lists["GRPriceListRel"] = many;
    EXPECT_THROW(OpenList(session.state, "criterion"), base::RuntimeError);
}

TEST_F(PriceListTest, OnlyThePricesOfThePageAreRead) {
    catalogue.PageLength = 2;
    session.state.templates.PriceQueryText = "prices #A";
    MakeList(5);
    Rows();
    TurnPage(catalogue, "LastPage");
    Rows();
    EXPECT_EQ(session.application->asked,
              (std::vector<std::string>{"OpenList GRPriceListRel|criterion|GRArticle.Code",
                                        "OpenQuery prices 101,102",
                                        "OpenQuery prices 105"}));
}

TEST_F(PriceListTest, PricesOfARow) {
    MakeList(10);
    catalogue.RowCursor = 10;
    struct Case {
        const char* text;
        const char* html;
    };
    const Case cases[] = {
        {"<ZEB:GRPriceListRow>Price</ZEB:GRPriceListRow>", "10,00"},
        {"<ZEB:GRPriceListRel>price18</ZEB:GRPriceListRel>", "11,80"},
        {"<ZEB:GRPriceListRow>FinalPrice</ZEB:GRPriceListRow>", "9,00"},
        {"<ZEB:GRPriceListRow>FinalPrice18</ZEB:GRPriceListRow>", "10,62"},
        {"<ZEB:GRPriceListRow>PriceCut</ZEB:GRPriceListRow>", "-10"},
        {"<ZEB:GRPriceListRow>IDGRArticle</ZEB:GRPriceListRow>", "110"},
        {"<ZEB:QPriceList>FinalPrice18</ZEB:QPriceList>", "10,62"},
        {"<ZEB:QPriceList>FinalPrice</ZEB:QPriceList>", "9"},
        {"<ZEB:SavePriceTag/> <ZEB:SaveUPriceTag/>", "Price_10 UPrice_10"},
        // The cursor has passed the row: list row 10 is odd to it.
        {"<ZEB:HKRida12>odd;even</ZEB:HKRida12>", "odd"},
        {"<ZEB:HKRida12>one text</ZEB:HKRida12>", ""},
    };
    for (const Case& c : cases) {
        catalogue.RowCursor = 10;
        EXPECT_EQ(Page("<ZEB:HKRida>" + std::string(c.text) + "</ZEB:HKRida>"), c.html) << c.text;
    }
}

TEST_F(PriceListTest, TextsOfTheTemplateAndTheSortChoice) {
    EXPECT_EQ(Page("<ZEB:Order>\u00A0GRArticle.Name desc </ZEB:Order><ZEB:DataOrder/>"
                   "<ZEB:DataOrder.grarticle.name_DESC> now</ZEB:DataOrder.grarticle.name_DESC>"
                   "<ZEB:DataOrder.GRArticle.Name> not</ZEB:DataOrder.GRArticle.Name>"
                   "<ZEB:Grupp.Query>Category = '#F'</ZEB:Grupp.Query><ZEB:GRArticleCat>x"
                   "</ZEB:GRArticleCat>"),
              "GRArticle.Name desc now");
    EXPECT_EQ(catalogue.GroupQueryText, "Category = '42'");
    session.state.company.PriceFactor = 0.875;
    EXPECT_EQ(Page("<ZEB:DiscountPercent/>"), "12,5");
    catalogue.LastFind = "<b>\"";
    EXPECT_EQ(Page("<ZEB:LastFind/>"), "&lt;b&gt;&quot;");
    session.state.basket_form.RowIndex = 3;
    EXPECT_EQ(Page("<ZEB:MuudaKomment/> <ZEB:EditField.WantedDate/>"), "Expl_3 EF_WantedDate_3");
    EXPECT_TRUE(session.state.basket_form.ShowRowExplanations);
    EXPECT_TRUE(session.state.basket_form.EditableRowFields.contains("wanteddate"));
}

}  // namespace
}  // namespace zebtell::catalogue
