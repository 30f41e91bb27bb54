#include <gmock/gmock.h>

#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

using OrderFlow = PortalTest;

TEST_F(OrderFlow, NamedUserFromLogonToLogout) {
    Browser mari = NewBrowser();
    EXPECT_THAT(mari.Get(""), HasSubstr("[logon ]"));
    EXPECT_THAT(mari.LogOn("mari", "mari-sala"),
                HasSubstr("[frame user Oma Äri OÜ Mari Maasikas Ema AS Müügi Meelis]"));

    // The first view is the favourites: what the company has bought before.
    EXPECT_THAT(mari.Get("Kaubainfo"),
                HasSubstr("[kaubad  rows=2 page=1/1 find= order= allowed=yes]"));
    EXPECT_THAT(mari.page(),
                HasSubstr("{KR-1|Kruvi M6 pikk|10,00|8,50|10,03|ID_1101|"
                          "/?page=Lisamine&event=ID_1101|/?page=KInfo&event=Show&ID=101}\n"
                          "{KR-2|Kruvi M8|0,33|0,33|0,39|ID_1102|"));

    // Two articles, one of them with a sum that doubles would round to the wrong cent.
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "3"}, {"ID_1103", "2,5"}, {"ID_1102", ""}});
    EXPECT_THAT(mari.page(), HasSubstr("[basket rows=2 quantity=5,5 total=28,02]"));
    EXPECT_THAT(mari.page(),
                HasSubstr("(1|KR-1|3|25,50|&nbsp;|Row_1|Expl_1)\n"
                          "(2|OR-1|2,5|2,52|&nbsp;|Row_2|Expl_2)"));
    EXPECT_EQ(mari.address(), "/?page=Kaubainfo");

    mari.Post("Kaubainfo&event=Tellimus",
              {{"Change_Quant", "1"},
               {"Row_1", "4"},
               {"Row_2", "2.5"},
               {"Expl_1", "kiire <b>"},
               {"Expl_2", ""}});
    EXPECT_THAT(mari.page(), HasSubstr("total=36,52]"));
    EXPECT_THAT(mari.page(), HasSubstr("(1|KR-1|4|34,00|kiire &lt;b&gt;|Row_1|Expl_1)"));

    mari.Post("Kaubainfo&event=Tellimus", {{"Vormista", "1"}});
    EXPECT_THAT(mari.page(),
                HasSubstr("[koost2  sum=36,52 with tax=44,91 comment= wanted=]\n"
                          "(KR-1|4,00|8,50|34,00)\n(OR-1|2,50|1,01|2,52)\n"));

    // Back to the catalogue: what was typed is there when the page is seen again.
    mari.Post("Kinnitus&event=LisaTellimus",
              {{"ZEB_But_Tagasi", "1"},
               {"ZEB_Komment", "tooge \"ukse\" ette"},
               {"SDOrder.WantedDate", "2026-12-01"}});
    EXPECT_EQ(mari.address(), "/?page=Kaubainfo");
    EXPECT_THAT(mari.Get("Kinnitus"),
                HasSubstr("comment=tooge &quot;ukse&quot; ette wanted=2026-12-01]"));

    mari.Post("Kinnitus&event=LisaTellimus",
              {{"ZEB_But_Vormista", "1"},
               {"ZEB_Komment", "tooge ette"},
               {"SDOrder.WantedDate", "2026-12-01"}});
    EXPECT_EQ(mari.address(), "/?page=Tellimus");
    EXPECT_THAT(mari.page(), HasSubstr("[tellimus  just saved number=7004 "));
    EXPECT_THAT(mari.page(),
                HasSubstr("comment=tooge ette sum=36,52 tax=8,39 all=44,91]\n"
                          "(KR-1|4,00|34,00|kiire &lt;b&gt;)\n"
                          "(OR-1|2,50|2,52|)\n"
                          "tax(9|2,52|0,23)\ntax(24|34,00|8,16)\n"));
    EXPECT_THAT(mari.Get("Tellimus"), Not(HasSubstr("just saved")));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[no basket]"));

    EXPECT_EQ(company().Run("SELECT Number, DocDate, WantedDate, State, IDGRCompany, "
                            "IDGRCompContPerson, IDGRPriceList, Explanation, Amount, TaxAmount, "
                            "AmountWTax, NeedsReview FROM SDOrder WHERE Number = 7004"),
              "7004|2026-11-21|2026-12-01|0|1|1|1|tooge ette|36.52|8.39|44.91|0\n");
    EXPECT_EQ(company().Run("SELECT RowNo, IDGRArticle, Quantity, Price, r.Amount, TaxPercent, "
                            "r.Explanation, Status FROM SDOrderRow r JOIN SDOrder o ON "
                            "r.IDSDOrder = o.ID WHERE Number = 7004 ORDER BY RowNo"),
              "1|101|4.0|8.5|34|24.0|kiire <b>|0\n2|103|2.5|1.01|2.52|9.0|NULL|0\n");
    EXPECT_EQ(company().Run("SELECT TaxPercent, Base, t.Amount FROM GDTax t JOIN SDOrder o ON "
                            "t.IDGDocument = o.ID WHERE Number = 7004 ORDER BY 1"),
              "9.0|2.52|0.23\n24.0|34|8.16\n");

    EXPECT_THAT(mari.Get("Logout"), HasSubstr("[logout]"));
    EXPECT_THAT(mari.Get("Kaubainfo&event=Favorites"),
                HasSubstr("[logon (Sessioon katkestatud - sisenege uuesti!)]"));
    EXPECT_THAT(mari.Get("Logon"), HasSubstr("[logon ]"));
    EXPECT_THAT(Log(), HasSubstr("[U] mari logged in (127.0.0.1;127.0.0.1)\r\n"));
    EXPECT_THAT(Log(), HasSubstr("[U] mari logged out\r\n"));
    EXPECT_THAT(Log(), Not(HasSubstr(" error:")));
}

TEST_F(OrderFlow, GuestOrdersWithNameAndAddress) {
    Browser guest = NewBrowser();
    EXPECT_THAT(guest.LogOn("", ""), HasSubstr("[frame guest Jaeklient"));
    guest.Get("Kaubainfo");
    // No price category: the list price is the guest's own.
    EXPECT_THAT(guest.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", "kr-1"}}),
                HasSubstr("{KR-1|Kruvi M6 pikk|10,00|10,00|"));
    guest.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
    guest.Post("Kinnitus&event=LisaTellimus",
               {{"ZEB_But_Vormista2", "1"},
                {"ZEB_Nimi", "Jüri <Tamm>"},
                {"ZEB_Aadress", "Kase 3"},
                {"ZEB_Komment", ""}});
    EXPECT_THAT(guest.page(), HasSubstr("[kinnitatud just saved /?page=Tellimus&event=ID_"));
    const std::string link = guest.page().substr(guest.page().find("/?page"));
    EXPECT_THAT(guest.GetPath(link.substr(0, link.find(']'))),
                HasSubstr("name=Jüri &lt;Tamm&gt; "));
    EXPECT_EQ(company().Run("SELECT IDGRCompany, CompanyName, CompanyAddr, AmountWTax "
                            "FROM SDOrder WHERE Number = 7004"),
              "4|Jüri <Tamm>|Kase 3|12.4\n");

    // Another guest of the same shop does not see it.
    Browser other = NewBrowser();
    other.LogOn("", "");
    EXPECT_THAT(other.GetPath(link.substr(0, link.find(']'))),
                HasSubstr("(Probleem andmete lugemisel, proovige uuesti!)"));
}

TEST_F(OrderFlow, ListSearchCategoryAndPages) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    EXPECT_THAT(
        mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", ""}, {"Combo_GRArticleCat", "0"}}),
        HasSubstr("rows=48 page=1/3"));
    EXPECT_THAT(mari.page(),
                HasSubstr("<OPTION SELECTED VALUE=\"0\">Kõik\r\n"
                          "<OPTION VALUE=\"1\">Kinnitid\r\n"
                          "<OPTION VALUE=\"2\">Tihendid &amp; muu\r\n"));
    EXPECT_THAT(mari.Get("Kaubainfo&event=Navigate&Nav=LastPage"), HasSubstr("page=3/3"));
    EXPECT_THAT(mari.page(), HasSubstr("{L-39|"));
    EXPECT_THAT(mari.page(), Not(HasSubstr("{L-38|")));
    EXPECT_THAT(mari.page(), HasSubstr("{OR-1|O'Ring &lt;5&gt; & \"7\"|1,15|1,01|1,19|"));
    // A plain request keeps the page once, then begins at the first.
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("page=3/3"));
    EXPECT_THAT(mari.page(), HasSubstr("{L-39|"));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("page=1/3"));
    EXPECT_THAT(mari.Get("Kaubainfo&event=NextPage"), HasSubstr("page=2/3"));
    EXPECT_THAT(mari.Get("Kaubainfo&event=Navigate&Nav=PrevPage"), HasSubstr("page=1/3"));
    EXPECT_THAT(mari.Get("Kaubainfo&event=Navigate&Nav=PrevPage"), HasSubstr("page=1/3"));

    EXPECT_THAT(
        mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", ""}, {"Combo_GRArticleCat", "2"}}),
        HasSubstr("rows=1 page=1/1"));
    EXPECT_THAT(mari.page(), HasSubstr("<OPTION SELECTED VALUE=\"2\">"));
    EXPECT_THAT(mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", "kruvi  pikk"}}),
                HasSubstr("rows=1 page=1/1 find=kruvi  pikk"));
    EXPECT_THAT(mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", "KR?2"}}),
                HasSubstr("{KR-2|"));
    // Lines without a price: left out of the list, found by the search.
    EXPECT_THAT(mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", "hinnata"}}),
                HasSubstr("rows=0 page=1/0"));
    EXPECT_THAT(mari.Post("Kaubainfo&event=Otsing", {{"ZEBInText", "hinnata"}}),
                HasSubstr("rows=1 page=1/1"));

    mari.Post(
        "Kaubainfo&event=Hinnakiri",
        {{"DataOrder", "GRArticle.Code desc"}, {"ZEBInText", ""}, {"Combo_GRArticleCat", "1"}});
    EXPECT_THAT(mari.page(), HasSubstr("order=GRArticle.Code desc"));
    EXPECT_LT(mari.page().find("{KR-2|"), mari.page().find("{KR-1|"));
}

TEST_F(OrderFlow, ArticlePageAndSingleRow) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    EXPECT_THAT(mari.Get("KInfo&event=Show&ID=103"), HasSubstr("[info OR-1 9 here]"));
    EXPECT_THAT(mari.Get("KInfo&event=Show&ID=abc"), HasSubstr("[info &nbsp; &nbsp; here]"));
    EXPECT_THAT(mari.Get("Lisamine&event=ID_1102"), HasSubstr("[lisarida  KR-2 0,33 0,39 0,41]"));
    EXPECT_THAT(mari.Get("Kaubainfo&event=ID_1101"),
                HasSubstr("[lisarida  KR-1 10,00 11,80 12,40]"));
    EXPECT_THAT(mari.Post("Lisamine&event=Lisamine", {{"IDGRArticle", "101"}, {"ZEBInQuant", "2"}}),
                HasSubstr("[lisatud 1]"));
    // A row that failed stays, uncounted, and is not stored with the order.
    EXPECT_THAT(
        mari.Post("Lisamine&event=Lisamine", {{"IDGRArticle", "101"}, {"ZEBInQuant", "abc"}}),
        HasSubstr("[lisarida (Viga rea lisamisel!) KR-1"));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=1 quantity=2 total=17,00]"));
    mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}});
    EXPECT_EQ(company().Run("SELECT count(*), sum(r.Amount) FROM SDOrderRow r JOIN SDOrder o ON "
                            "r.IDSDOrder = o.ID WHERE Number = 7004"),
              "1|17\n");
}

TEST_F(OrderFlow, CompositionDeletesRowsAndLeadsOn) {
    Browser mari = MariLoggedOn();
    EXPECT_THAT(mari.Post("Koostamine&event=Vormista", {{"ZEB_But_Lisatellimus", "Vormista"}}),
                HasSubstr("[koost1"));
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}, {"ID_1102", "10"}, {"ID_1103", "1"}});
    EXPECT_THAT(mari.Get("Koostamine"),
                HasSubstr("(KR-1|1,00|8,50|/?page=Koostamine&event=DEL_1)\n"
                          "(KR-2|10,00|3,30|/?page=Koostamine&event=DEL_2)\n"
                          "(OR-1|1,00|1,01|/?page=Koostamine&event=DEL_3)\n"));
    EXPECT_THAT(mari.Get("Koostamine&event=DEL_2"), HasSubstr("event=DEL_2)\n\n"));
    EXPECT_THAT(mari.Get("Koostamine&event=DEL_9"), HasSubstr("(OR-1|"));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=2 quantity=2 total=9,51]"));
    EXPECT_THAT(mari.Post("Koostamine&event=Vormista", {{"ZEB_But_LisaRidu", "lisa ridu"}}),
                HasSubstr("[kaubad"));
    EXPECT_THAT(mari.Post("Koostamine&event=Vormista", {{"ZEB_But_Lisatellimus", "Vormista"}}),
                HasSubstr("[koost2"));
    mari.Post("Koostamine&event=Vormista", {{"ZEB_But_Loobu", "1"}});
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[no basket]"));
}

TEST_F(OrderFlow, QuickEntryByCodeAndBarcode) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine",
              {{"ID_unique", "1"},
               {"Code_f1", "kr-1"},
               {"Quantity_f1", "1"},
               {"Code_f2", ""},
               {"Quantity_f2", ""},
               {"Code_f3", "4740000000028"},
               {"Quantity_f3", "1 000"},
               {"Code_f4", "O'Ring"},
               {"Quantity_f4", "2"},
               {"Code_f5", "SA-1"},
               {"Quantity_f5", "1"},
               {"ID_1103", "-5"},
               {"ID_1101", "x1"}});
    EXPECT_THAT(mari.page(), HasSubstr("[basket rows=2 quantity=1001 total=338,50]"));
    EXPECT_THAT(mari.page(),
                HasSubstr("(Need jäid lisamata või muutmata: OR-1 &quot;-5&quot;, KR-1 "
                          "&quot;x1&quot;, O&#39;Ring &quot;2&quot;, SA-1 &quot;1&quot;)"));
    // The same article again: more of it instead of a second row.
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_unique", "1"}, {"ID_1101", "2"}});
    EXPECT_THAT(mari.page(), HasSubstr("(1|KR-1|3|25,50|"));
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "2"}});
    EXPECT_THAT(mari.page(), HasSubstr("(3|KR-1|2|17,00|"));
}

TEST_F(OrderFlow, StoredOrdersAreOpenedCopiedAndGuarded) {
    Browser mari = MariLoggedOn();
    EXPECT_THAT(mari.Get("Tellimus&event=ID_501"), HasSubstr("number=7001"));
    // Somebody else's order and none at all get the same answer.
    const std::string foreign = mari.Get("Tellimus&event=ID_502");
    EXPECT_THAT(foreign, HasSubstr("(Probleem andmete lugemisel, proovige uuesti!)"));
    EXPECT_EQ(mari.Get("Tellimus&event=ID_999999"), foreign);

    EXPECT_THAT(mari.Get("Kinnitus&event=ID_501"), HasSubstr("(KR-1|2,00|8,50|17,00)"));
    mari.Post("Kaubainfo&event=Tellimus", {{"Change_Quant", "1"}, {"Row_1", "5"}});
    mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}, {"ZEB_Komment", "uus"}});
    EXPECT_EQ(
        company().Run("SELECT Number, Explanation, Amount, TaxAmount FROM SDOrder WHERE ID = 501"),
        "7001|uus|42.5|10.2\n");
    EXPECT_EQ(company().Run("SELECT count(*) FROM SDOrder"), "3\n");

    // Staff have begun with this one: refused, and the basket is intact.
    mari.Get("Kinnitus&event=ID_503");
    EXPECT_THAT(mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}}),
                HasSubstr("[koost2 (Probleem tellimuse salvestamisel! Tellimust juba täidetakse, "
                          "seda ei saa enam muuta.) sum="));
    EXPECT_THAT(mari.page(), HasSubstr("(KR-1|1,00|"));
    EXPECT_EQ(company().Run("SELECT Explanation FROM SDOrder WHERE ID = 503"), "töös\n");

    EXPECT_THAT(mari.Get("Kinnitus&event=COPY_503"), HasSubstr("(KR-1|1,00|8,50|8,50)\n\n"));
    EXPECT_THAT(mari.Get("Kinnitus&event=New"), HasSubstr("sum=0,00"));
    EXPECT_THAT(mari.Get("Kinnitus&event=COPY_502"),
                HasSubstr("(Probleem andmete lugemisel, proovige uuesti!)"));
}

TEST_F(OrderFlow, RepeatedFailuresBlockTheSession) {
    const char* blocked = "(Sessioon blokeeritud, proovige uuesti 5 minuti pärast!)";
    for (const double minutes : {6.0, -1e4}) {
        Browser browser = NewBrowser();
        for (int i = 0; i < 4; ++i)
            EXPECT_THAT(browser.LogOn("mari", "wrong"), HasSubstr("(Vale "));
        EXPECT_THAT(browser.LogOn("mari", "mari-sala"), HasSubstr(blocked));
        now = base::DateTime(now.days() + minutes / (24 * 60));
        EXPECT_THAT(browser.LogOn("mari", "mari-sala"), HasSubstr("[frame user")) << minutes;
    }
    EXPECT_THAT(NewBrowser().LogOn("endine", "mari-sala"), HasSubstr("(Vale"));
}

TEST_F(OrderFlow, LogonGivesANewToken) {
    Browser mari = NewBrowser();
    mari.Get("");
    const std::string before = mari.cookie();
    mari.LogOn("mari", "mari-sala");
    EXPECT_NE(mari.cookie(), before);
    Browser thief = NewBrowser();
    thief.set_cookie(before);
    EXPECT_THAT(thief.Get("Kaubainfo"), HasSubstr("[logon"));
    EXPECT_THAT(Log(), Not(HasSubstr(mari.cookie().substr(mari.cookie().find('=') + 1))));
}

}  // namespace
}  // namespace zebtell
