#include <gmock/gmock.h>

#include <thread>

#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

using TagsFlow = PortalTest;

// What a browser sends back for <input value="...">.
std::string Typed(const std::string& page, const std::string& start) {
    const std::size_t at = page.find(start);
    if (at == std::string::npos) return "no " + start;
    std::string text = page.substr(at + start.size());
    text = text.substr(0, text.find('"'));
    const std::pair<const char*, const char*> kEntities[] = {{"&lt;", "<"},
                                                             {"&gt;", ">"},
                                                             {"&quot;", "\""},
                                                             {"&#39;", "'"},
                                                             {"&acute;", "\u00B4"},
                                                             {"&nbsp;", "\u00A0"},
                                                             {"&amp;", "&"}};
    for (const auto& [entity, character] : kEntities) {
        text = base::Replaced(text, entity, character);
    }
    return text;
}

TEST_F(TagsFlow, BasketFormSentUnchangedChangesNothing) {
    folder.Write("templates/zebtell_kaubad.htm",
                 "<ZEB:RoundQuantity>3</ZEB:RoundQuantity>"
                 "<ZEB:Orders.Enable>OrdersAllowed</ZEB:Orders.Enable>"
                 "<ZEB:Tellimus.Read><input name=\"<ZEB:MuudaKogus/>\" value=\""
                 "<ZEB:Tellimus.Rida>Quantity;zeb:attr</ZEB:Tellimus.Rida>\">"
                 "<input name=\"<ZEB:MuudaKomment/>\" value=\""
                 "<ZEB:Tellimus.Rida>Explanation;zeb:attr</ZEB:Tellimus.Rida>\">"
                 "</ZEB:Tellimus.Read>");
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Lisamine&event=Lisamine", {{"IDGRArticle", "101"}, {"ZEBInQuant", "2,5"}});
    mari.Get("Kaubainfo");
    EXPECT_THAT(mari.page(), HasSubstr("name=\"Expl_1\" value=\"\">"));
    std::string comment = "O'Ring 5\" &amp; <b>";
    for (int times = 0; times < 3; ++times) {
        mari.Post("Kaubainfo&event=Tellimus",
                  {{"Change_Quant", "1"},
                   {"Row_1", times == 0 ? "2,5" : Typed(mari.page(), "name=\"Row_1\" value=\"")},
                   {"Expl_1", comment}});
        EXPECT_THAT(mari.page(), Not(HasSubstr("<b>")));
        EXPECT_EQ(Typed(mari.page(), "name=\"Row_1\" value=\""), "2,5");
        comment = Typed(mari.page(), "name=\"Expl_1\" value=\"");
        EXPECT_EQ(comment, "O'Ring 5\" &amp; <b>");
    }
}

// Two clicks on the log-on button: the browser drops the first answer and keeps its old cookie
// until the second comes.
TEST_F(TagsFlow, LogonSentTwiceEndsLoggedOn) {
    const std::string settings = folder.Read("ZEBTell.ini");
    folder.Write("ZEBTell.ini", base::Replaced(settings, "Level=Detail", "Level=Debug"));
    Browser mari = NewBrowser();
    mari.Get("Logon");
    Browser dropped = mari;
    std::thread first([&] { dropped.LogOn("mari", "mari-sala"); });
    while (Log().find("+Req+beg+ page=Logon&event=Logon") == std::string::npos) {
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    mari.LogOn("mari", "mari-sala");
    first.join();
    EXPECT_THAT(mari.Get("Yld"), HasSubstr("[yld]"));
}

TEST_F(TagsFlow, BackBehindTheLogonAndTheLogout) {
    Browser mari = MariLoggedOn();
    // Back to the log-on page, and the form sent again, with the basket as it was.
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
    mari.Get("Logon");
    EXPECT_THAT(mari.LogOn("MARI", "mari-sala"), HasSubstr("[frame user"));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=1"));

    // Back behind the logout: the old form leads to the log-on page and stores nothing.
    mari.Get("Logout");
    EXPECT_THAT(mari.Get("Logout"), HasSubstr("[logout]"));
    EXPECT_THAT(mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}}),
                HasSubstr("[logon (Sessioon katkestatud - sisenege uuesti!)]"));
    EXPECT_EQ(company().Run("SELECT count(*) FROM SDOrder"), "3\n");
}

TEST_F(TagsFlow, HugeNamesAtTheLogon) {
    Browser browser = NewBrowser();
    const std::string huge(300'000, 'x');
    EXPECT_THAT(browser.LogOn(huge, huge), HasSubstr("[logon (Vale kasutajanimi"));
    EXPECT_LT(Log().size(), 2000U);
    EXPECT_THAT(browser.LogOn("mari", "mari-sala"), HasSubstr("[frame user"));
}

}  // namespace
}  // namespace zebtell
