#include <gmock/gmock.h>

#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

// Tags that tell people where they are and what became of what they did.
class PageTags : public PortalTest {
  protected:
    void Template(const std::string& file, const std::string& text) const {
        folder.Write("templates/" + file, text);
    }
    Browser MariWith(const std::string& catalogue) const {
        Template(
            "zebtell_kaubad.htm",
            "<ZEB:Pagelen>0</ZEB:Pagelen><ZEB:RoundQuantity>3</ZEB:RoundQuantity>" + catalogue);
        Browser mari = NewBrowser();
        mari.LogOn("mari", "mari-sala");
        mari.Post("Kaubainfo&event=Otsing", {{"ZEBInText", ""}});
        return mari;
    }
};

TEST_F(PageTags, RowsSayWhatTheBasketHoldsAndWhatThePriceIsWithTax) {
    Browser mari = MariWith(
        "<ZEB:HKRida>{<ZEB:GRPriceListRow>GRArticle.Code</ZEB:GRPriceListRow> "
        "<ZEB:QPriceList>FinalPriceWTax</ZEB:QPriceList>"
        "<ZEB:Korvis> has <ZEB:KorvisKogus>0.00</ZEB:KorvisKogus></ZEB:Korvis>}</ZEB:HKRida>");
    EXPECT_THAT(mari.page(), HasSubstr("{KR-1 10,54}{KR-2 0,41}"));
    EXPECT_THAT(mari.page(), HasSubstr("{OR-1 1,10}")) << "an article's own tax";
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "2"}});
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1,5"}, {"ID_1103", "4"}});
    EXPECT_THAT(mari.page(), HasSubstr("{KR-1 10,54 has 3,50}{KR-2 0,41}")) << "two rows of it";
    EXPECT_THAT(mari.page(), HasSubstr("{OR-1 1,10 has 4,00}"));
    mari.Post("Kaubainfo&event=Tellimus",
              {{"Change_Quant", "1"}, {"Row_1", "0"}, {"Row_2", "0"}, {"Row_3", "9"}});
    EXPECT_THAT(mari.page(), HasSubstr("{KR-1 10,54}"));
    EXPECT_THAT(mari.page(), HasSubstr("{OR-1 1,10 has 9,00}"));
}

TEST_F(PageTags, WhatBecameOfAFormIsSaidOnceAndBesideItsFields) {
    Browser mari = MariWith(
        "<ZEB:Added>[added <ZEB:Added.Count/>]</ZEB:Added>"
        "<ZEB:HKRida><ZEB:LisaKogus.Refused>(<ZEB:LisaKogus/>: Typed)</ZEB:LisaKogus.Refused>"
        "</ZEB:HKRida><ZEB:QuickEntry.Refused>[lines Typed]</ZEB:QuickEntry.Refused>"
        "<ZEB:Tellimus.Read><ZEB:MuudaKogus.Refused>(<ZEB:MuudaKogus/>: Typed)"
        "</ZEB:MuudaKogus.Refused></ZEB:Tellimus.Read>[end]");
    mari.Post("Kaubainfo&event=Lisamine",
              {{"ID_1101", "<b>"},
               {"ID_1102", "2"},
               {"Code_f1", "POLE"},
               {"Quantity_f1", "1"},
               {"QuickEntry", "4740000000011\t5\nOR-1\tx\nSA-1\t3\n"}});
    EXPECT_EQ(mari.page(), "[added 2](ID_1101: &lt;b&gt;)[lines POLE\t1\nOR-1\tx\nSA-1\t3\n][end]");
    EXPECT_EQ(mari.Get("Kaubainfo"), "[end]");
    std::string many;
    for (int n = 1; n <= 501; ++n) many += "OR-1\t1\n";
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_unique", "1"}, {"QuickEntry", many}});
    EXPECT_EQ(mari.page(), "[added 500][lines OR-1\t1\n][end]") << "too many at once";
    mari.Get("Koostamine&event=DEL_3&Next=Kaubainfo");
    mari.Post("Kaubainfo&event=Tellimus",
              {{"Change_Quant", "1"}, {"Row_1", "3"}, {"Row_2", "palju"}});
    EXPECT_EQ(mari.page(), "(Row_2: palju)[end]");
    // The form of the basket's own page leads back there.
    Template("zebtell_koost1.htm",
             "[basket <ZEB:TellRidu/>]<ZEB:Tellimus.Read><input name=\"<ZEB:MuudaKomment/>\" "
             "value=\"<ZEB:Tellimus.Rida>Explanation;zeb:attr</ZEB:Tellimus.Rida>\">"
             "<ZEB:MuudaKogus.Refused>(Typed)</ZEB:MuudaKogus.Refused></ZEB:Tellimus.Read>");
    mari.Get("Koostamine");
    mari.Post("Kaubainfo&event=Tellimus&Next=Koostamine",
              {{"Change_Quant", "1"}, {"Row_1", "nii"}, {"Expl_2", "kiire"}});
    EXPECT_EQ(mari.page(),
              "[basket 2]<input name=\"Expl_1\" value=\"\">(nii)"
              "<input name=\"Expl_2\" value=\"kiire\">");
    mari.Post("Kaubainfo&event=Tellimus&Next=Koostamine", {{"Order_Clear", "1"}});
    EXPECT_EQ(mari.page(), "[basket 0]");
}

TEST_F(PageTags, AnArticleShowsTheCustomersPrice) {
    Template(
        "zebtell_info.htm",
        "[<ZEB:QPriceList>ID</ZEB:QPriceList> <ZEB:QPriceList>FinalPrice;0.00</ZEB:QPriceList> "
        "<ZEB:QPriceList>FinalPriceWTax</ZEB:QPriceList>]");
    Browser mari = MariLoggedOn();
    EXPECT_EQ(mari.Get("KInfo&event=Show&ID=103"), "[1103 1,01 1,10]");
    EXPECT_EQ(mari.Get("KInfo"), "[1103 1,01 1,10]");
    EXPECT_EQ(mari.Get("KInfo&event=Show&ID=105"), "[  ]") << "in none of her price lists";
    EXPECT_EQ(mari.Get("KInfo&event=Show&ID=none"), "[  ]");
}

TEST_F(PageTags, TheStartPageShowsTheLastOrdersOfTheCustomerOnly) {
    Template("zebtell_frame.htm",
             "<ZEB:RecentOrders>[<ZEB:RecentOrder>"
             "<ZEB:SDOrder>Number</ZEB:SDOrder>=<ZEB:SDOrder>AmountWTax</ZEB:SDOrder> "
             "</ZEB:RecentOrder>]</ZEB:RecentOrders>[end]");
    Browser mari = NewBrowser();
    EXPECT_EQ(mari.Get("Raamistik"), "[end]") << "nobody is logged on";
    EXPECT_EQ(mari.LogOn("mari", "mari-sala"), "[7003=10,54 7001=21,08 ][end]");
    for (int n = 0; n < 5; ++n) {
        mari.Get("Kinnitus&event=COPY_501");
        mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}});
    }
    const std::string page = mari.Get("Raamistik");
    EXPECT_EQ(std::count(page.begin(), page.end(), '='), 5);
    EXPECT_THAT(page, Not(HasSubstr("7003=")));
    Browser guest = NewBrowser();
    EXPECT_EQ(guest.LogOn("", ""), "[end]");
}

TEST_F(PageTags, TheNavigationKnowsItsPageAndAGuestIsNotTheShop) {
    const std::string here =
        "<ZEB:Page.Yld>terms</ZEB:Page.Yld><ZEB:Page.kinnitus>confirm"
        "</ZEB:Page.kinnitus>";
    Template("zebtell_yld.htm", here);
    Template("zebtell_koost2.htm",
             here +
                 " [<ZEB:Recipient>CompanyName</ZEB:Recipient>] "
                 "<ZEB:Refused.SDOrder.WantedDate>(Typed)</ZEB:Refused.SDOrder.WantedDate>");
    Browser mari = MariLoggedOn();
    EXPECT_EQ(mari.Get("Yld"), "terms");
    EXPECT_EQ(mari.Get("Kinnitus&event=New"), "confirm [Oma Äri OÜ] ");
    mari.Post("Kinnitus&event=LisaTellimus",
              {{"ZEB_But_Vormista", "1"}, {"SDOrder.WantedDate", "2020-01-01"}});
    EXPECT_EQ(mari.page(), "confirm [Oma Äri OÜ] (2020-01-01)");
    EXPECT_EQ(mari.Get("Kinnitus"), "confirm [Oma Äri OÜ] ");
    Browser guest = NewBrowser();
    guest.LogOn("", "");
    EXPECT_EQ(guest.Get("Kinnitus&event=New"), "confirm [] ");
    guest.Post("Kinnitus&event=LisaTellimus",
               {{"ZEB_But_Tagasi", "1"}, {"SDOrder.CompanyName", "Jüri"}});
    EXPECT_EQ(guest.Get("Kinnitus"), "confirm [Jüri] ");
}

}  // namespace
}  // namespace zebtell
