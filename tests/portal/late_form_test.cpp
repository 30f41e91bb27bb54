#include <gmock/gmock.h>

#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::Not;

// Confirmations that come late or twice: the browser repeats them, or a person goes back to them.
class LateForm : public PortalTest {
  protected:
    static constexpr const char* kStoredBefore = "(Tellimus on salvestatud nii, nagu siin näha.)";
    static constexpr const char* kNoBasket =
        "(Tellimust ei salvestatud: seda korvi enam ei ole, palun koostage tellimus uuesti.)";
    static constexpr const char* kOtherBasket =
        "(Tellimust ei salvestatud: korvis on nüüd teine tellimus, palun vaadake see üle.)";

    Browser LoggedOn(const std::string& user) const {
        Browser browser = NewBrowser();
        browser.LogOn(user, user.empty() ? "" : "mari-sala");
        return browser;
    }
    // A basket of so many KR-1, at the confirmation page; returns the form's key.
    static std::string FillBasket(Browser& browser, const std::string& quantity) {
        browser.Get("Kaubainfo");
        browser.Post("Kaubainfo&event=Lisamine", {{"ID_1101", quantity}});
        const std::string& page = browser.Get("Kinnitus");
        const std::size_t key = page.find("key=") + 4;
        return page.substr(key, page.find(';', key) - key);
    }
    static const std::string& Confirm(Browser& browser,
                                      const std::string& key,
                                      const char* button = "ZEB_But_Vormista") {
        return browser.Post("Kinnitus&event=LisaTellimus", {{"ZEB_DocKey", key}, {button, "1"}});
    }
    std::string NewOrders() const {
        return company().Run("SELECT Number, Amount FROM SDOrder WHERE Number > 7003 ORDER BY 1");
    }
};

TEST_F(LateForm, ShowsTheStoredOrderWhoeverOfTheCompanySendsItAgain) {
    Browser mari = MariLoggedOn();
    const std::string key = FillBasket(mari, "3");
    EXPECT_EQ(key.size(), 32U);
    EXPECT_THAT(Confirm(mari, key), HasSubstr("[tellimus  just saved number=7004 "));
    const auto expect_shown = [&](Browser& browser, const char* label) {
        EXPECT_THAT(
            Confirm(browser, key),
            AllOf(HasSubstr(kStoredBefore), HasSubstr("number=7004 "), HasSubstr("(KR-1|3")))
            << label;
        EXPECT_THAT(Confirm(browser, key, "ZEB_But_Vormista2"), HasSubstr("[kinnitatud ")) << label;
        EXPECT_EQ(NewOrders(), "7004|25.5\n") << label;
    };
    expect_shown(mari, "once more");
    mari.Get("Logout");
    EXPECT_THAT(Confirm(mari, key), HasSubstr("[logon (")) << "nobody is logged on";
    mari.LogOn("mari", "mari-sala");
    expect_shown(mari, "after a new log-on");
    Browser other = MariLoggedOn();
    expect_shown(other, "from another session");
    Start(kUsualSettings);
    mari = MariLoggedOn();
    expect_shown(mari, "after a restart");
    // Back, or dropping what is stored already, changes nothing either.
    EXPECT_THAT(Confirm(mari, key, "ZEB_But_Tagasi"), HasSubstr("[kaubad "));
    EXPECT_THAT(Confirm(mari, key, "ZEB_But_Kustuta"), HasSubstr("[kinnitatud "));
    EXPECT_EQ(NewOrders(), "7004|25.5\n");
}

TEST_F(LateForm, LeavesTheBasketThatThereIsNowAlone) {
    Browser mari = MariLoggedOn();
    const std::string stored = FillBasket(mari, "3");
    Confirm(mari, stored);
    const std::string dropped = FillBasket(mari, "5");
    mari.Post("Kaubainfo&event=Tellimus", {{"Order_Clear", "1"}});
    EXPECT_THAT(Confirm(mari, dropped), AllOf(HasSubstr(kNoBasket), HasSubstr("[kaubad ")));
    const std::string now = FillBasket(mari, "7");
    EXPECT_THAT(Confirm(mari, stored), HasSubstr("number=7004 "));
    EXPECT_THAT(Confirm(mari, dropped),
                AllOf(HasSubstr(kOtherBasket), HasSubstr("(KR-1|7,00|8,50|59,50)")));
    EXPECT_THAT(Confirm(mari, dropped, "ZEB_But_Kustuta"), HasSubstr("(KR-1|7,00|"));
    mari.Post(
        "Kinnitus&event=LisaTellimus",
        {{"ZEB_DocKey", dropped}, {"ZEB_But_Tagasi", "1"}, {"ZEB_Komment", "teise korvi oma"}});
    EXPECT_THAT(mari.Get("Kinnitus"), HasSubstr(" comment= "));
    EXPECT_EQ(NewOrders(), "7004|25.5\n");
    EXPECT_THAT(Confirm(mari, now), HasSubstr("just saved number=7005 "));

    // Lost with the session: the customer is told that nothing was stored.
    const std::string lost = FillBasket(mari, "9");
    mari.Get("Logout");
    mari.LogOn("mari", "mari-sala");
    EXPECT_THAT(Confirm(mari, lost), HasSubstr(kNoBasket));
    EXPECT_EQ(NewOrders(), "7004|25.5\n7005|59.5\n");
}

TEST_F(LateForm, OfAChangedOrderShowsHowItStands) {
    Browser mari = MariLoggedOn();
    const std::string key = FillBasket(mari, "3");
    Confirm(mari, key);
    const std::string id = company().Run("SELECT ID FROM SDOrder WHERE Number = 7004");
    mari.Get("Kinnitus&event=ID_" + id.substr(0, id.size() - 1));
    EXPECT_THAT(mari.page(), HasSubstr("key=" + key + ";"));
    mari.Post("Kaubainfo&event=Tellimus", {{"Change_Quant", "1"}, {"Row_1", "4"}});
    EXPECT_THAT(Confirm(mari, key), HasSubstr("just saved number=7004 "));
    EXPECT_THAT(Confirm(mari, key), AllOf(HasSubstr(kStoredBefore), HasSubstr("(KR-1|4,00|")));
    EXPECT_EQ(NewOrders(), "7004|34\n");
}

TEST_F(LateForm, FindsTheOrderWhoseAnswerTheDatabaseLost) {
    Browser mari = MariLoggedOn();
    for (const char* button : {"ZEB_But_Vormista2", "ZEB_But_Kustuta"}) {
        const std::string key = FillBasket(mari, "3");
        company().Run("INSERT INTO GDocument (Kind, DocKey) VALUES ('SDOrder', '" + key +
                      "'); INSERT INTO SDOrder (ID, Number, DocDate, IDGRCompany, Amount) SELECT "
                      "max(ID), 7100 + max(ID), '2026-11-21', 1, 25.5 FROM GDocument");
        const std::string orders = NewOrders();
        Confirm(mari, key, button);
        EXPECT_THAT(mari.Get("Tellimus"), HasSubstr("number=76")) << button;
        EXPECT_THAT(mari.page(), HasSubstr("[tellimus (Tellimus on salvestatud")) << button;
        EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[no basket]")) << button;
        EXPECT_EQ(NewOrders(), orders) << button;
    }
}

TEST_F(LateForm, KeysOfOthersSayNothing) {
    Browser mari = MariLoggedOn();
    const std::string key = FillBasket(mari, "3");
    Confirm(mari, key);
    Browser teine = LoggedOn("teine");
    teine.Get("Kaubainfo");
    const std::string unknown = Confirm(teine, std::string(32, '0'));
    EXPECT_THAT(unknown, HasSubstr(kNoBasket));
    const std::string keys[] = {key, "a1", "a2'", "' or 1=1 --", "%", std::string(5000, 'a')};
    for (const std::string& other : keys) {
        EXPECT_EQ(Confirm(teine, other), unknown) << other;
        EXPECT_THAT(teine.Get("Tellimus"), HasSubstr("number=&nbsp; ")) << other;
    }
    // Guests share a company; the key is what one of them knows and the others do not.
    Browser guest = LoggedOn("");
    const std::string own = FillBasket(guest, "1");
    Confirm(guest, own);
    Browser same = LoggedOn("");
    EXPECT_THAT(Confirm(same, own), HasSubstr("number=7005 "));
    EXPECT_THAT(Confirm(same, key), HasSubstr(kNoBasket));
    EXPECT_THAT(Log(), Not(AnyOf(HasSubstr(key), HasSubstr(own))));
}

TEST_F(LateForm, ClocksThatJumpChangeDatesOnly) {
    Browser mari = MariLoggedOn();
    for (const char* day : {"2036-11-21", "2016-02-29", "2026-11-21"}) {
        const std::string key = FillBasket(mari, "1");
        now = *base::DateTime::FromIso(day);
        EXPECT_THAT(Confirm(mari, key), HasSubstr("just saved")) << day;
    }
    EXPECT_EQ(
        company().Run("SELECT Number, d.Created FROM SDOrder o JOIN GDocument d ON d.ID = o.ID "
                      "WHERE Number > 7003 ORDER BY 1"),
        "7004|2036-11-21\n7005|2016-02-29\n7006|2026-11-21\n");
}

}  // namespace
}  // namespace zebtell
