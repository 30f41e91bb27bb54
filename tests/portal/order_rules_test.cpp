#include <gmock/gmock.h>

#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::Not;

class OrderRules : public PortalTest {
  protected:
    // Somebody who has logged on and seen no page yet.
    Browser LoggedOnBlind(const std::string& user) const {
        Browser browser = NewBrowser();
        const std::string form =
            Browser::Encoded({{"ZEB_IN_KASUTAJATUNNUS", user}, {"ZEB_IN_PAROOL", "mari-sala"}});
        EXPECT_EQ(browser.Ask("/?page=Logon&event=Logon", "POST", form).status, 303);
        return browser;
    }
    std::string OrderCount() const { return company().Run("SELECT count(*) FROM SDOrder"); }
};

TEST_F(OrderRules, AListIsWholeAlsoAsTheFirstPageOfASession) {
    struct Case {
        const char* event;
        const char* list;
    };
    const Case cases[] = {
        {"Favorites", "rows=2 page=1/1"},
        {"Hinnakiri", "rows=48 page=1/3"},
        {"Otsing", "rows=49 page=1/3"},
        // Nothing to turn: the catalogue opens as ever.
        {"Navigate&Nav=NextPage", "rows=2 page=1/1"},
        {"LastPage", "rows=2 page=1/1"},
    };
    for (const Case& c : cases) {
        Browser mari = LoggedOnBlind("mari");
        const std::string page = "Kaubainfo&event=" + std::string(c.event);
        EXPECT_THAT(mari.Post(page, {{"ZEBInText", ""}, {"Combo_GRArticleCat", "0"}}),
                    HasSubstr(c.list))
            << c.event;
        EXPECT_EQ(mari.page().find("[kaubad"), mari.page().rfind("[kaubad")) << "written once";
    }
    // Decimals of quantities are declared by that template too.
    Browser mari = LoggedOnBlind("mari");
    EXPECT_THAT(mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "2,5"}}),
                HasSubstr("[basket rows=1 quantity=2,5 total=21,25]"));
}

TEST_F(OrderRules, SortingTheFavouritesForgetsTheSearchBeforeThem) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", "lisa"}, {"Combo_GRArticleCat", "0"}});
    EXPECT_THAT(mari.page(), HasSubstr("rows=45 page=1/3 find=lisa"));
    EXPECT_THAT(mari.Get("Kaubainfo&event=Favorites"), HasSubstr("rows=2 page=1/1 find= "));
    // An order that there is not: the list and its order stay.
    mari.Post("Kaubainfo&event=Hinnakiri",
              {{"DataOrder", "Nonsense.Field"}, {"ZEBInText", ""}, {"Combo_GRArticleCat", "-1"}});
    EXPECT_THAT(mari.page(),
                HasSubstr("(Probleem andmete lugemisel, proovige uuesti!) rows=2 page=1/1 find= "
                          "order= "));
    EXPECT_THAT(mari.Get("Kaubainfo&event=Favorites"), Not(HasSubstr("Probleem")));
}

TEST_F(OrderRules, WhoMayNotOrderIsRefusedByEveryForm) {
    constexpr const char* kRefused =
        "(Tellimine ei ole lubatud, palun pöörduge oma müügiesindaja poole!)";
    company().Run(
        "INSERT INTO GDocument (ID, Kind, DocKey) VALUES (504, 'SDOrder', 'a4');"
        "INSERT INTO SDOrder (ID, Number, DocDate, State, IDGRCompany, IDGRPriceList) VALUES "
        "(504, 6999, '2026-10-04', 0, 5, 1);"
        "INSERT INTO SDOrderRow (ID, IDSDOrder, RowNo, IDGRArticle, Quantity, Price, UnitPrice, "
        "Amount, TaxPercent, Status) VALUES (5041, 504, 1, 101, 1, 10, 10, 10, 24, 0)");
    const std::string orders = OrderCount();
    for (const bool blind : {true, false}) {
        Browser blokk = LoggedOnBlind("blokk");
        if (!blind) blokk.Get("Kaubainfo");
        EXPECT_THAT(blokk.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}}),
                    HasSubstr(kRefused));
        EXPECT_THAT(blokk.page(), HasSubstr("[no basket]"));
        EXPECT_THAT(
            blokk.Post("Lisamine&event=Lisamine", {{"IDGRArticle", "101"}, {"ZEBInQuant", "1"}}),
            HasSubstr(kRefused));
        EXPECT_THAT(blokk.Get("Kinnitus&event=COPY_504"), HasSubstr("(KR-1|1,00|10,00|10,00)"));
        EXPECT_THAT(blokk.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}}),
                    HasSubstr(kRefused));
        EXPECT_THAT(blokk.page(), HasSubstr("(KR-1|1,00|")) << "the basket is kept";
        EXPECT_EQ(OrderCount(), orders);
    }
}

TEST_F(OrderRules, ARefusedFieldIsNamedAndTheOthersAreKept) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
    struct Case {
        const char* label;
        const char* date;
        std::string name;
        const char* message;
    };
    const Case cases[] = {
        {"date over", "2020-01-01", "", "salvestamisel! Soovitud tarnepäev on möödas.)"},
        {"long name", "2027-01-01", std::string(101, 'x'), "salvestamisel! Nimi on liiga pikk.)"},
    };
    for (const Case& c : cases) {
        for (const char* button : {"ZEB_But_Vormista", "ZEB_But_Vormista2"}) {
            mari.Post("Kinnitus&event=LisaTellimus",
                      {{button, "1"},
                       {"SDOrder.WantedDate", c.date},
                       {"ZEB_Nimi", c.name},
                       {"ZEB_Komment", std::string("jätke ") + button}});
            EXPECT_THAT(mari.page(), HasSubstr(c.message)) << c.label;
            EXPECT_THAT(mari.page(), HasSubstr(std::string("comment=jätke ") + button)) << c.label;
        }
    }
    // A date that is none is skipped, and the order stored.
    mari.Post("Kinnitus&event=LisaTellimus",
              {{"ZEB_But_Vormista", "1"}, {"SDOrder.WantedDate", "homme"}});
    EXPECT_EQ(company().Run("SELECT WantedDate FROM SDOrder WHERE Number = 7004"), "2027-01-01\n");
}

TEST_F(OrderRules, RowsAreTakenOutOnceAndLeaveTheTotals) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}, {"ID_1102", "10"}});
    // The address that the browser shows then can be loaded again.
    const auto answer = mari.Ask("/?page=Koostamine&event=DEL_1", "GET", "");
    EXPECT_EQ(answer.status, 303);
    EXPECT_EQ(answer.Header("Location"), "/?page=Koostamine");
    // A link in the catalogue leads back to the page of the list that was shown, and nowhere else.
    mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", ""}, {"Combo_GRArticleCat", "0"}});
    mari.Get("Kaubainfo&event=NextPage");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
    EXPECT_THAT(mari.Get("Koostamine&event=DEL_2&Next=kaubainfo"),
                AllOf(HasSubstr("[kaubad  rows=48 page=2/3"), HasSubstr("[basket rows=1 ")));
    EXPECT_THAT(mari.Get("Koostamine&event=DEL_9&Next=http://x"), HasSubstr("[koost1 "));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=1 quantity=10 total=3,30]"));

    // A row whose adding failed was never counted.
    mari.Post("Lisamine&event=Lisamine", {{"IDGRArticle", "101"}, {"ZEBInQuant", "1e300"}});
    EXPECT_THAT(mari.page(), HasSubstr("(Viga rea lisamisel!)"));
    mari.Get("Koostamine&event=DEL_2");
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=1 quantity=10 total=3,30]"));

    // A stored order's row leaves with the sum that it was counted by.
    mari.Get("Kinnitus&event=ID_501");
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=1 quantity=2 total=17,00]"));
    mari.Get("Koostamine&event=DEL_1");
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=0 quantity=0 total=0,00]"));
}

TEST_F(OrderRules, GoingOnAppliesTheChangesWhenTheFormSaysSo) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}, {"ID_1102", "10"}});
    EXPECT_THAT(mari.Post("Kaubainfo&event=Tellimus", {{"Vormista", "1"}, {"Row_1", "5"}}),
                HasSubstr("(KR-1|1,00|"));
    mari.Post("Kaubainfo&event=Tellimus",
              {{"Vormista", "1"}, {"Vormista_Muuda", "1"}, {"Row_1", "5"}, {"Row_2", "x"}});
    EXPECT_THAT(mari.page(),
                HasSubstr("[koost2 (Need jäid lisamata või muutmata: KR-2 &quot;x&quot;) sum="));
    EXPECT_THAT(mari.page(), HasSubstr("(KR-1|5,00|8,50|42,50)\n(KR-2|10,00|"));
    EXPECT_THAT(mari.Post("Kaubainfo&event=Tellimus",
                          {{"Vormista", "1"}, {"Change_Quant", "1"}, {"Row_1", "6"}}),
                HasSubstr("(1|KR-1|6|51,00|"))
        << "both buttons: changed, and back in the catalogue";
}

TEST_F(OrderRules, QuickEntryTakesAnyTextForACode) {
    // What is one article's barcode may be another's code.
    company().Run("UPDATE GRArticle SET Barcode = 'KR-2' WHERE ID = 101");
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    EXPECT_THAT(mari.Post("Kaubainfo&event=Lisamine", {{"Code_f1", "KR-2"}, {"Quantity_f1", "1"}}),
                HasSubstr("(1|KR-2|1|0,33|"));
    const std::string codes[] = {"'", "}", std::string("a\0b", 3), std::string(5000, 'k')};
    int count = 1;
    for (const std::string& code : codes) {
        mari.Post("Kaubainfo&event=Lisamine",
                  {{"Code_f1", code}, {"Quantity_f1", "1"}, {"ID_1101", "1"}});
        EXPECT_THAT(mari.page(), HasSubstr("(Need jäid lisamata või muutmata: ")) << code;
        EXPECT_THAT(mari.page(), HasSubstr("[basket rows=" + std::to_string(++count) + " "))
            << code;
    }
}

}  // namespace
}  // namespace zebtell
