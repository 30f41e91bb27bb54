#include <gmock/gmock.h>

#include <filesystem>
#include <regex>
#include <string>
#include <vector>

#include "app/pages.h"
#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::Not;

constexpr const char* kOtherSite = "Sec-Fetch-Site: cross-site\r\n";
// Whatever a form could ask for, so that a handler that runs has something to do.
constexpr const char* kForm =
    "ID_1101=3&Code_f1=KR-1&Quantity_f1=2&IDGRArticle=101&ZEBInQuant=4&Row_1=9&Change_Quant=1"
    "&ZEBInText=k&SDOrder.Explanation=muudetud&ZEB_But_Vormista=1&ZEB_Komment=muudetud";

struct Asked {
    std::string address;
    bool open = false;
    bool changes = false;
};

// Every page and event of the page table, with the events that are made at run time.
std::vector<Asked> EverythingThatCanBeAsked() {
    std::vector<Asked> all;
    for (const host::Page& page : app::PortalPages()) {
        const bool open = page.rules.visitors == web::Visitors::kEverybody;
        const auto add = [&](const std::string& event, web::Effect effect) {
            const std::string address = Browser::Address(page.name) + event;
            all.push_back({address, open, effect == web::Effect::kChanges});
        };
        add("", page.rules.respond);
        for (const auto& event : page.events)
            add("&event=" + std::string(event.name), event.effect);
        for (const char* made : {"New", "ID_501", "COPY_501", "DEL_1", "Show&ID=101", "LastPage"}) {
            add("&event=" + std::string(made), page.rules.user_event);
        }
    }
    return all;
}

class Guards : public PortalTest {
  protected:
    Browser MariWithABasket() const {
        Browser mari = MariLoggedOn();
        mari.Get("Kaubainfo");
        mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
        return mari;
    }
    // What a customer owns: his basket, with its key, and the stored orders.
    std::string Belongings(Browser& browser) const {
        return browser.Get("Koostamine") + browser.Get("Kinnitus") +
               company().Run("SELECT * FROM SDOrder; SELECT * FROM SDOrderRow");
    }
    void UseDefaultTemplates() {
        using Options = std::filesystem::copy_options;
        std::filesystem::copy(SourceFolder() / "templates",
                              folder.path() / "templates",
                              Options::recursive | Options::overwrite_existing);
        Start(kUsualSettings);
    }
};

TEST_F(Guards, NobodyGetsInWithoutALogOn) {
    const std::string orders = company().Run("SELECT * FROM SDOrder; SELECT * FROM SDOrderRow");
    for (const bool default_templates : {false, true}) {
        if (default_templates) UseDefaultTemplates();
        Browser left = MariWithABasket();
        left.Get("Logout");
        Browser visitors[] = {NewBrowser(), left};
        std::string open_pages;
        for (const Asked& asked : EverythingThatCanBeAsked()) {
            if (asked.open && asked.address.find('&') == asked.address.npos)
                open_pages += asked.address.substr(asked.address.find('=')) + " ";
            for (Browser& visitor : visitors) {
                for (const char* method : {"GET", "POST"}) {
                    const auto answer = visitor.Ask(asked.address, method, kForm);
                    SCOPED_TRACE(asked.address + " " + method);
                    if (!asked.open) {
                        EXPECT_EQ(answer.status, 303);
                        EXPECT_EQ(answer.Header("Location"), "/?page=Logon");
                        EXPECT_EQ(answer.body, "");
                    }
                    EXPECT_THAT(answer.body,
                                Not(AnyOf(HasSubstr("Mari"),
                                          HasSubstr("Oma"),
                                          HasSubstr("KR-1"),
                                          HasSubstr("7001"),
                                          HasSubstr("8,50"))));
                }
            }
        }
        EXPECT_EQ(open_pages, "=Kasutaja =Lisatud =Logon =Logout =Raamistik =Vasak ");
    }
    EXPECT_EQ(company().Run("SELECT * FROM SDOrder; SELECT * FROM SDOrderRow"), orders);
}

TEST_F(Guards, OtherSitesCannotChangeAnything) {
    Browser mari = MariWithABasket();
    const std::string before = Belongings(mari);
    int links = 0;
    for (const Asked& asked : EverythingThatCanBeAsked()) {
        EXPECT_EQ(mari.Ask(asked.address, "POST", kForm, kOtherSite).status, 403) << asked.address;
        const int status = mari.Ask(asked.address, "GET", "", kOtherSite).status;
        EXPECT_EQ(status == 403, asked.changes) << asked.address << " " << status;
        links += asked.changes ? 1 : 0;
    }
    EXPECT_GT(links, 15);
    EXPECT_EQ(Belongings(mari), before);
}

TEST_F(Guards, WhatOnlyShowsChangesNothing) {
    Browser mari = MariWithABasket();
    const std::string before = Belongings(mari);
    for (const Asked& asked : EverythingThatCanBeAsked()) {
        if (asked.changes) continue;
        const bool has_event = asked.address.find('&') != asked.address.npos;
        mari.Ask(asked.address + "&" + kForm, "GET", "");
        if (has_event) mari.Ask(asked.address, "POST", kForm);
        ASSERT_EQ(Belongings(mari), before) << asked.address;
    }
}

TEST_F(Guards, ForeignAndUnknownNumbersGetTheSameAnswer) {
    const struct {
        const char *address, *form, *foreign;
    } rows[] = {
        {"Tellimus&event=ID_#", nullptr, "502"},
        {"Kinnitatud&event=ID_#", nullptr, "502"},
        {"Kinnitus&event=ID_#", nullptr, "502"},
        {"Kinnitus&event=COPY_#", nullptr, "502"},
        {"Kaubainfo&event=ID_#", nullptr, "2105"},
        {"Lisamine&event=ID_#", nullptr, "2105"},
        {"Kaubainfo&event=Lisamine", "ID_#=1", "2105"},
        {"Lisamine&event=Lisamine", "IDGRArticle=#&ZEBInQuant=1", "105"},
        {"Kaubainfo&event=Tellimus", "Change_Quant=1&SDOrder.IDGRCompContPerson=#", "2"},
        {"Kaubainfo&event=Tellimus", "Change_Quant=1&SDOrder.IDGRCompany=#", "2"},
        {"Kaubainfo&event=Tellimus", "Change_Quant=1&SDOrder.IDGRPriceList=#", "2"},
        {"Kinnitus&event=LisaTellimus", "ZEB_But_Vormista=1&SDOrder.IDGRCompContPerson=#", "2"},
    };
    const std::string unknown = "987654";
    const auto numbered = [](const std::string& text, const std::string& number) {
        return std::regex_replace(text, std::regex("#"), number);
    };
    for (const auto& row : rows) {
        const auto answers = [&](const std::string& number) {
            Browser mari = MariWithABasket();
            const std::string address = Browser::Address(numbered(row.address, number));
            const auto answer = row.form == nullptr
                                    ? mari.Ask(address, "GET", "")
                                    : mari.Ask(address, "POST", numbered(row.form, number));
            const std::string text = std::to_string(answer.status) + answer.Header("Location") +
                                     answer.body + mari.GetPath(answer.Header("Location")) +
                                     mari.Get("Kaubainfo") + mari.Get("Lisamine") +
                                     mari.Get("Kinnitus") + mari.Get("Tellimus");
            return std::regex_replace(text, std::regex("key=[0-9a-f]*;"), "");
        };
        const std::string foreign = answers(row.foreign);
        EXPECT_EQ(foreign, answers(unknown)) << row.address << " " << (row.form ? row.form : "");
        EXPECT_THAT(foreign, Not(AnyOf(HasSubstr("Salajane"), HasSubstr("SALADUS"))));
    }
}

}  // namespace
}  // namespace zebtell
