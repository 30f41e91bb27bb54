#include "host/logon.h"

#include <gmock/gmock.h>

#include "tests/host/session.h"

namespace zebtell::host {
namespace {

web::FieldList Form(std::string user, std::string password) {
    return web::FieldList(
        {{"ZEB_In_KasutajaTunnus", std::move(user)}, {"ZEB_In_Parool", std::move(password)}});
}

TEST(Logon, NamedUserGetsHisCompany) {
    TestSession s("[WEBLog]\nLevel=Detail\n");
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    EXPECT_EQ(s.response.redirect_address(), "?page=Raamistik");
    EXPECT_TRUE(s.call->renew_token());
    const SessionState& state = *s.state;
    EXPECT_TRUE(state.logon.LoggedOn);
    EXPECT_FALSE(state.logon.IsGuest);
    EXPECT_EQ(state.logon.UserName, "mari");
    EXPECT_EQ(state.company.CustomerKey, 5);
    EXPECT_EQ(state.company.PriceListId, 3);
    EXPECT_DOUBLE_EQ(state.company.PriceFactor, 0.9);
    EXPECT_TRUE(state.company.CompanyLoaded && state.company.ContactLoaded);
    EXPECT_FALSE(state.company.ParentLoaded);
    EXPECT_THAT(s.Log(), testing::HasSubstr("[U] mari logged in (10.1.2.3;10.1.2.3)\r\n"));
}

TEST(Logon, PriceListFallsBackToTheSettlementCompanys) {
    TestSession s;
    const auto base_database = s.database;
    s.database = [base_database] {
        auto application = base_database();
        application->user->fields["Partner.IDSettlCompany"] = 6;
        application->lists["GRCompany"] =
            fake::MakeList({{{"ID", 5}, {"IDParent", 6}}, {{"ID", 6}, {"IDGRPriceList", 44}}});
        return application;
    };
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    EXPECT_EQ(s.state->company.PriceListId, 44);
    EXPECT_TRUE(s.state->company.ParentLoaded);
}

TEST(Logon, GuestByNoNameAndByHisNameInAnyLetters) {
    for (const char* typed : {"", "külaline", "KÜLALINE"}) {
        TestSession s("[WebGuest]\nUserID=mari\nPassWord=Sala\n");
        s.Ask(Logon_Logon, Form(typed, "ignored"));
        EXPECT_TRUE(s.state->logon.LoggedOn) << typed;
        EXPECT_TRUE(s.state->logon.IsGuest) << typed;
        EXPECT_EQ(s.state->logon.UserName, "mari") << typed;
    }
}

TEST(Logon, SecondLogonWithTheSameCredentialsAsksNoDatabase) {
    TestSession s;
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    s.database = [] { return nullptr; };
    s.state->logon.ReturnPage = "Kaubainfo";
    s.Ask(Logon_Logon, Form("MARI", "SALA"));
    EXPECT_EQ(s.response.redirect_address(), "?page=Kaubainfo");
    EXPECT_EQ(s.state->logon.ReturnPage, "");
    EXPECT_TRUE(s.state->logon.LoggedOn);
}

// A browser that sends the form twice may drop the first answer and its cookie.
TEST(Logon, FormSentTwiceLeavesTheBrowserWithACookie) {
    TestSession s;
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    EXPECT_TRUE(s.call->renew_token());
    s.Ask(Logon_Logon, Form("mari", "wrong"));
    EXPECT_FALSE(s.call->renew_token());
}

TEST(Logon, OtherCredentialsLeaveNothingOfTheFirstUser) {
    TestSession s;
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    s.state->basket.Basket = std::make_shared<fake::Document>();
    s.state->catalogue.LastFind = "salajane";
    s.state->templates.SavedValues.emplace()["save_x"] = "1";
    s.state->basket_form.QuantityDecimals = 3;
    s.Ask(Logon_Logon, Form("mari", "wrong"));
    EXPECT_FALSE(s.state->logon.LoggedOn);
    EXPECT_EQ(s.state->logon.Application, nullptr);
    EXPECT_EQ(s.state->basket.Basket, nullptr);
    EXPECT_EQ(s.state->catalogue.LastFind, "");
    EXPECT_FALSE(s.state->templates.SavedValues);
    EXPECT_EQ(s.state->basket_form.QuantityDecimals, 3);  // the templates' word
    EXPECT_EQ(s.state->company.CompanyRecord, nullptr);
    EXPECT_EQ(s.state->Message, "Vale kasutajanimi või parool!");
}

TEST(Logon, EveryFailureGivesOneMessageInThreeLanguages) {
    const std::pair<const char*, const char*> kCases[] = {
        {"EST", "Vale kasutajanimi või parool!"},
        {"English", "Invalid user name or password!"},
        {"LV", "Nederīgs lietotājvārds vai parole!"}};
    for (const auto& [language, message] : kCases) {
        TestSession s("[DataBase]\nLanguage=" + std::string(language));
        s.Ask(Logon_Logon, Form("mari", "wrong"));
        EXPECT_EQ(s.state->Message, message);
        EXPECT_EQ(s.response.redirect_address(), "?page=Logon");
        // A user whose company can't be read is not let in either.
        s.database = [] {
            auto application = std::make_unique<fake::Application>();
            application->user_name = "mari";
            return application;
        };
        s.state->Message.clear();
        s.Ask(Logon_Logon, Form("mari", ""));
        EXPECT_EQ(s.state->Message, message);
        EXPECT_FALSE(s.state->logon.LoggedOn);
    }
}

TEST(Logon, BlocksAfterTheLimitAndLiftsAfterTheTime) {
    TestSession s("[Session]\nBlocking=3\nTimeout=10\n");
    const auto minutes = [](double m) { return m / (24 * 60); };
    for (int i = 0; i < 3; ++i) s.Ask(Logon_Logon, Form("mari", "wrong"));
    EXPECT_FALSE(s.state->blocking.Blocked);
    s.Ask(Logon_Logon, Form("mari", "wrong"));
    EXPECT_TRUE(s.state->blocking.Blocked);
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    EXPECT_EQ(s.state->Message, "Sessioon blokeeritud, proovige uuesti 10 minuti pärast!");
    EXPECT_FALSE(s.state->logon.LoggedOn);
    const base::DateTime failed = s.now;
    s.now = base::DateTime(failed.days() + minutes(10.4));
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    EXPECT_FALSE(s.state->logon.LoggedOn);
    s.now = base::DateTime(failed.days() + minutes(11));
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    EXPECT_TRUE(s.state->logon.LoggedOn);
}

TEST(Logon, NoLimitCountsNothing) {
    TestSession s("[Session]\nBlocking=0\nTimeout=10\n");
    for (int i = 0; i < 20; ++i) s.Ask(Logon_Logon, Form("mari", "wrong"));
    EXPECT_EQ(s.state->blocking.FailedAttempts, 0);
    EXPECT_EQ(s.state->blocking.LastAttemptedName, "");
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    EXPECT_TRUE(s.state->logon.LoggedOn);
}

TEST(Logon, HugeNamesAreRefusedAndNotKept) {
    TestSession s("[Session]\nBlocking=3\n[WEBLog]\nLevel=Debug\n");
    s.Ask(Logon_Logon, Form(std::string(1'000'000, 'x'), std::string(1'000'000, 'y')));
    EXPECT_EQ(s.state->blocking.LastAttemptedName, std::string(200, 'x'));
    EXPECT_EQ(s.state->logon.UserName, "");
    EXPECT_LT(s.Log().size(), 1000U);
}

// A guesser begins a new session for every try.
TEST(Logon, NewSessionsAreNoWayAroundTheLimit) {
    TestSession s("[Session]\nBlocking=0\n[DataBase]\nLanguage=EN\n");
    const auto try_in_new_session = [&](const char* user, const char* password) {
        s.state = NewSession(s.services);
        s.Ask(Logon_Logon, Form(user, password));
        return s.state->Message;
    };
    for (int i = 0; i < 50; ++i) {
        ASSERT_EQ(try_in_new_session("mari", "wrong"), "Invalid user name or password!");
    }
    const std::string wait = "Too many failed log-ons, try again after 60 seconds!";
    EXPECT_EQ(try_in_new_session("mari", "Sala"), wait) << "also with the right password";
    EXPECT_EQ(try_in_new_session("MARI", "wrong"), wait);
    EXPECT_EQ(s.state->blocking.FailedAttempts, 0);
    EXPECT_EQ(try_in_new_session("nobody", "wrong"), "Invalid user name or password!");
}

TEST(Logout, OfASessionThatIsNotLoggedOn) {
    TestSession s;
    s.Ask(Logout_Respond);
    EXPECT_EQ(s.templates_written, 1);
    EXPECT_TRUE(s.call->release_instance());
    EXPECT_THAT(s.Log(), testing::HasSubstr("[-]  logged out\r\n"));
}

TEST(Logout, ReleasesTheInstanceAndKeepsOnlyTheName) {
    TestSession s;
    s.Ask(Logon_Logon, Form("mari", "Sala"));
    s.Ask(Logout_Respond);
    EXPECT_TRUE(s.call->release_instance());
    EXPECT_EQ(s.templates_written, 1);
    EXPECT_FALSE(s.state->logon.LoggedOn);
    EXPECT_EQ(s.state->logon.UserName, "mari");
    EXPECT_THAT(s.Log(), testing::HasSubstr("[U] mari logged out\r\n"));
}

TEST(Logon, LineBreaksInANameDoNotForgeLogEntries) {
    TestSession s;
    const auto base_database = s.database;
    s.database = [base_database] {
        auto application = base_database();
        application->user_name = "mari\r\n2026[U] evil";
        return application;
    };
    s.Ask(Logon_Logon, Form("mari\r\n2026[U] evil", "Sala"));
    EXPECT_THAT(s.Log(), testing::HasSubstr("] mari  2026[U] evil logged in"));
}

}  // namespace
}  // namespace zebtell::host
