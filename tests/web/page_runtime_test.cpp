#include "web/page_runtime.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <barrier>
#include <thread>

#include "tests/web/test_site.h"

namespace zebtell::web {
namespace {

using testing::HasSubstr;
using testing::Not;

TEST(PageRuntime, DispatchesByPageAndEvent) {
    const struct {
        const char* label;
        const char* target;
        int status;
        const char* body;
    } rows[] = {
        {"no page", "/", 200, "<p>Esimene 1 /?page=Teine&event=ID_7%20%26%22%C3%B5</p>"},
        {"page alone", "/?page=TEINE", 200, "second Teine"},
        {"page without Respond", "/?page=mall", 200, "second template kept"},
        {"empty event", "/?page=Teine&event=", 200, "second Teine"},
        {"custom event", "/?page=esimene&event=loe&both=b", 200, "b"},
        {"event made at run time", "/?page=Esimene&event=ID_5", 200, "user:ID_5"},
        {"decoded event", "/?page=Esimene&event=a%20b%26", 200, "user:a b&"},
        {"event of a page without UserEvent", "/?page=Teine&event=X", 200, "second template kept"},
        {"silent custom event", "/?page=Mall&event=Vaikne", 200, "second template kept"},
        {"silent UserEvent", "/?page=Mall&event=silent", 200, "second template kept"},
        {"next item", "/?page=Esimene&event=Edasi", 200, "from Esimene, second Teine"},
        {"redirect", "/?page=Esimene&event=Suuna", 303, ""},
    };
    for (const auto& row : rows) {
        TestSite site;
        const auto response = Browser(site).Get(row.target);
        EXPECT_EQ(response.status, row.status) << row.label;
        EXPECT_EQ(response.body, row.body) << row.label;
    }
}

TEST(PageRuntime, RaisesTheHooksInOrder) {
    TestSite site;
    {
        Browser browser(site);
        browser.Get("/");
        EXPECT_EQ(site.journal().Take(), "initialize begin start Esimene end");
        browser.Get("/?page=Esimene&event=Edasi");
        EXPECT_EQ(site.journal().Take(), "begin Edasi Teine end");
        EXPECT_EQ(browser.Get("/?page=Esimene&event=Suuna").headers.back(),
                  http::Header("Location", "/?page=Teine&event=x%20y"));
    }
    site.journal().Take();
    site.runtime().Stop();
    EXPECT_EQ(site.journal().Take(), "terminate");
}

TEST(PageRuntime, HandlersErrorsEndAsAPageWithoutDetails) {
    const struct {
        const char* target;
        const char* journal;
    } rows[] = {
        {"/?page=Esimene&event=Viga", "begin fatal(secret detail) end"},
        {"/?page=Esimene&event=Number", "begin fatal(Unknown error) end"},
        {"/?page=Ring", "begin fatal(Too many next items) end"},
        {"/?page=Mujale", "begin fatal(There is no such page) end"},
        {"/?page=Puudu", "begin fatal(File not found: missing.htm) end"},
        {"/?page=Halb", "begin fatal(Type mismatch) end"},
    };
    TestSite site;
    Browser browser(site);
    browser.Get("/");
    site.journal().Take();
    for (const auto& row : rows) {
        const auto response = browser.Get(row.target);
        EXPECT_EQ(response.status, 500) << row.target;
        EXPECT_EQ(HeaderOf(response, "Location"), "(none)");
        EXPECT_THAT(response.body, HasSubstr("<h1>Server error</h1>"));
        EXPECT_THAT(response.body, Not(HasSubstr("secret")));
        EXPECT_THAT(response.body, Not(HasSubstr("half a page")));
        EXPECT_EQ(site.journal().Take(), row.journal);
    }
    EXPECT_EQ(browser.Get("/?page=Esimene&event=Viga&own=1").body, "own error page");
    EXPECT_THAT(browser.Get("/").body, HasSubstr("Esimene 2")) << "the session survives";
}

TEST(PageRuntime, AnswersWhatIsNoPageWithoutMakingASession) {
    RuntimeOptions options;
    options.base_path = "/portal";
    options.static_files = [](const http::Request& request) -> std::optional<http::Response> {
        if (request.Path() != "/static/x.css") return std::nullopt;
        return http::Response{.status = 200, .headers = {}, .body = "css", .shared_body = {}};
    };
    TestSite site(std::move(options));
    Browser browser(site);
    EXPECT_EQ(browser.Get("/static/x.css").body, "css");
    EXPECT_EQ(browser.Get("/portal?page=None").status, 404);
    EXPECT_EQ(browser.Get("/other").status, 404);
    EXPECT_EQ(browser.Get("/portals").status, 404);
    const auto refused = browser.Send(
        {.method = "PUT", .target = "/portal", .headers = {}, .body = {}, .remote_address = {}});
    EXPECT_EQ(refused.status, 405);
    EXPECT_EQ(HeaderOf(refused, "Allow"), "GET, HEAD, POST");
    EXPECT_EQ(site.runtime().CountSessions().all, 0U);
    EXPECT_EQ(site.journal().Take(), "");
    EXPECT_THAT(browser.Get("/portal/").body, HasSubstr("/portal?page=Teine"));
    EXPECT_EQ(HeaderOf(Browser(site).Get("/portal"), "Set-Cookie").substr(40),
              "; Path=/portal; HttpOnly; SameSite=Lax");
}

TEST(PageRuntime, RefusesWhatAnotherSiteSends) {
    const http::Header browser_name{"User-Agent", "Mozilla/5.0 (X11)"};
    const struct {
        const char* label;
        const char* method;
        const char* target;
        std::vector<http::Header> headers;
        int status;
    } rows[] = {
        {"own post", "POST", "Esimene&event=Loe", {{"Origin", "http://shop.example:8080"}}, 200},
        {"letters", "POST", "Esimene&event=Loe", {{"Origin", "HTTP://Shop.Example:8080"}}, 200},
        {"no browser", "POST", "Esimene&event=Loe", {{"Accept", "*/*"}}, 200},
        {"own fetch", "POST", "Esimene&event=Loe", {{"Sec-Fetch-Site", "same-origin"}}, 200},
        {"foreign post", "POST", "Esimene&event=Loe", {{"Origin", "http://evil.example"}}, 403},
        {"port", "POST", "Esimene&event=Loe", {{"Origin", "http://shop.example:81"}}, 403},
        {"no origin at all", "POST", "Esimene&event=Loe", {{"Origin", "null"}}, 403},
        {"no event", "POST", "Esimene", {{"Sec-Fetch-Site", "cross-site"}}, 403},
        {"neighbour", "POST", "Esimene&event=Loe", {{"Sec-Fetch-Site", "same-site"}}, 403},
        {"unknown word", "POST", "Esimene&event=Loe", {{"Sec-Fetch-Site", "moon"}}, 403},
        {"link to event", "GET", "Esimene&event=Loe", {{"Sec-Fetch-Site", "cross-site"}}, 403},
        {"to run-time event", "GET", "Esimene&event=ID_1", {{"Sec-Fetch-Site", "cross-site"}}, 403},
        {"link to a page", "GET", "Esimene", {{"Sec-Fetch-Site", "cross-site"}}, 200},
        {"to a page that acts", "GET", "Teeb", {{"Sec-Fetch-Site", "cross-site"}}, 403},
        {"own, to one that acts", "GET", "Teeb", {{"Sec-Fetch-Site", "same-origin"}}, 200},
        {"typed address", "GET", "Esimene&event=Loe", {{"Sec-Fetch-Site", "none"}}, 200},
        {"foreign referrer", "GET", "Teeb", {{"Referer", "http://evil.example/shop.example"}}, 403},
        {"own referrer",
         "GET",
         "Teeb",
         {browser_name, {"Referer", "http://shop.example:8080/a"}},
         200},
        {"silent browser", "GET", "Esimene&event=Loe", {browser_name}, 403},
        {"silent, to a page", "GET", "Esimene", {browser_name}, 200},
        {"typed in a browser", "GET", "Teeb", {browser_name, {"Sec-Fetch-Site", "none"}}, 200},
    };
    TestSite site;
    Browser browser(site);
    for (const auto& row : rows) {
        http::Request request;
        request.method = row.method;
        request.target = std::string("/?page=") + row.target;
        request.headers = row.headers;
        EXPECT_EQ(browser.Send(std::move(request)).status, row.status) << row.label;
    }
}

// Another site that makes the browser ask could learn from the packed length what stands beside the
// text that it chose.
TEST(PageRuntime, PacksLongPagesButNotForOtherSites) {
    TestSite site;
    Browser browser(site);
    const http::Header gzip{"Accept-Encoding", "gzip"};
    const std::string text(5000, 'x');
    const auto ask = [&](std::vector<http::Header> headers) {
        return browser.Get("/?page=Mall&event=Vaata&both=" + text, std::move(headers));
    };
    const auto plain = ask({});
    const auto packed = ask({gzip});
    EXPECT_EQ(plain.body, text);
    EXPECT_EQ(HeaderOf(plain, "Vary"), "Accept-Encoding");
    EXPECT_EQ(HeaderOf(plain, "Content-Encoding"), "(none)");
    EXPECT_LT(packed.body.size(), 200U);
    EXPECT_EQ(HeaderOf(packed, "Content-Encoding"), "gzip");
    EXPECT_EQ(HeaderOf(packed, "Vary"), "Accept-Encoding");
    const auto foreign = ask({gzip, {"Sec-Fetch-Site", "cross-site"}});
    EXPECT_EQ(foreign.body, text);
    EXPECT_EQ(HeaderOf(browser.Get("/", {gzip}), "Content-Encoding"), "(none)") << "short";
}

TEST(PageRuntime, SessionsKeepRenewAndReleaseTheirInstance) {
    TestSite site;
    Browser browser(site);
    const auto first = browser.Get("/");
    EXPECT_THAT(HeaderOf(first, "Set-Cookie"),
                testing::MatchesRegex("ZEBTell=[0-9a-f]+; Path=/; HttpOnly; SameSite=Lax"));
    EXPECT_EQ(browser.cookie.size(), 32U);
    const auto second = browser.Get("/");
    EXPECT_THAT(second.body, HasSubstr("Esimene 2"));
    EXPECT_EQ(HeaderOf(second, "Set-Cookie"), "(none)");
    EXPECT_THAT(Browser(site).Get("/").body, HasSubstr("Esimene 1"));

    Browser thief(site);
    thief.cookie = browser.cookie;
    EXPECT_EQ(browser.Get("/?page=Esimene&event=Sisene").body, "in");
    EXPECT_NE(browser.cookie, thief.cookie);
    EXPECT_EQ(site.runtime().CountSessions().logged_on, 1U);
    EXPECT_THAT(browser.Get("/").body, HasSubstr("Esimene 3")) << "the same instance";
    EXPECT_THAT(thief.Get("/").body, HasSubstr("Esimene 1")) << "the old token is worth nothing";

    site.journal().Take();
    browser.Get("/?page=Esimene&event=Valju");
    EXPECT_EQ(site.journal().Take(), "begin end terminate");
    EXPECT_THAT(browser.Get("/").body, HasSubstr("Esimene 1")) << "a fresh instance";
    EXPECT_EQ(site.runtime().CountSessions().logged_on, 0U);
}

TEST(PageRuntime, CookieIsSecureOverTls) {
    TestSite site;
    Browser browser(site);
    const auto response = browser.Send({.method = "HEAD",
                                        .target = "/",
                                        .headers = {},
                                        .body = {},
                                        .remote_address = {},
                                        .secure = true});
    EXPECT_THAT(HeaderOf(response, "Set-Cookie"), HasSubstr("; Secure"));
    EXPECT_THAT(response.body, HasSubstr("Esimene")) << "the server leaves the body of a HEAD out";
}

TEST(PageRuntime, IdleSessionsEndAndAFullHouseIsTold) {
    RuntimeOptions options;
    options.max_sessions = 2;
    TestSite site(std::move(options));
    Browser first(site), second(site), third(site);
    first.Get("/?page=Esimene&event=Sisene");
    second.Get("/");
    third.Get("/");
    EXPECT_THAT(first.Get("/").body, HasSubstr("Esimene 1")) << "logged on, stays";
    third.Get("/?page=Esimene&event=Sisene");
    const auto refused = second.Get("/");
    EXPECT_EQ(refused.status, 503);
    EXPECT_EQ(HeaderOf(refused, "Retry-After"), "1");
    site.Pass(std::chrono::minutes(21));
    EXPECT_EQ(second.Get("/").status, 200) << "those who are gone leave their place";
}

TEST(PageRuntime, AFailedInitialisationIsToldAndTriedAgain) {
    std::string logged;
    int made = 0;
    RuntimeOptions options;
    options.log = [&](std::string_view text) { logged = text; };
    Journal journal;
    markup::TemplateCache templates(markup::TemplateFolders{"/nonexistent"});
    PageRuntime<TestState> runtime(
        TestPages(),
        TestHooks(),
        [&]() -> std::unique_ptr<TestState> {
            if (++made == 1) throw std::runtime_error("no settings");
            return std::unique_ptr<TestState>(new TestState{journal});
        },
        templates,
        std::move(options));
    http::Response response;
    const auto keep = [&](http::Response answer) { response = std::move(answer); };
    runtime({.method = "GET",
             .target = "/?page=Teine",
             .headers = {},
             .body = {},
             .remote_address = {}},
            keep);
    EXPECT_EQ(response.status, 500);
    EXPECT_EQ(logged, "no settings");
    const std::string cookie = HeaderOf(response, "Set-Cookie");
    runtime({.method = "GET",
             .target = "/?page=Teine",
             .headers = {{"Cookie", cookie.substr(0, cookie.find(';'))}},
             .body = {},
             .remote_address = {}},
            keep);
    EXPECT_EQ(response.body, "second Teine");
}

Page<TestState> PageWithEvents(const char* name, std::initializer_list<const char*> events) {
    Page<TestState> page{name, "a.htm", nullptr, nullptr, nullptr, {}};
    for (const char* event : events) page.events.push_back({event, Teine_Respond, Work::kQuick});
    return page;
}

TEST(PageRuntime, RefusesATableWithNamesTwice) {
    markup::TemplateCache templates(markup::TemplateFolders{"."});
    const auto make = [&](std::vector<Page<TestState>> pages) {
        PageRuntime<TestState> runtime(pages, TestHooks(), nullptr, templates, {});
    };
    EXPECT_THROW(make({PageWithEvents("A", {}), PageWithEvents("a", {})}), std::logic_error);
    EXPECT_THROW(make({PageWithEvents("A", {"E", "e"})}), std::logic_error);
    EXPECT_NO_THROW(make({PageWithEvents("A", {"E"}), PageWithEvents("B", {"E"})}));
}

// However many log-ons wait, the others are answered, and what is too much is told so.
TEST(PageRuntime, AFloodOfLogOnsIsBoundedAndHoldsNobodyUp) {
    RuntimeOptions options;
    options.worker_threads = 1;
    options.most_log_ons = 3;
    options.quick_on_io_threads = false;
    TestSite site(std::move(options));
    std::promise<void> may_end;
    site.meet = [end = may_end.get_future().share()] { end.wait(); };
    std::array<std::promise<int>, 5> answers;
    for (auto& answer : answers) {
        site.runtime()({.method = "POST",
                        .target = "/?page=Esimene&event=Logi",
                        .headers = {},
                        .body = {},
                        .remote_address = {}},
                       [&](const http::Response& response) { answer.set_value(response.status); });
    }
    EXPECT_EQ(answers[3].get_future().get(), 503);
    EXPECT_EQ(answers[4].get_future().get(), 503);
    EXPECT_EQ(Browser(site).Get("/?page=Teine").body, "second Teine");
    may_end.set_value();
    for (int i = 0; i < 3; ++i) EXPECT_EQ(answers[i].get_future().get(), 200);
    EXPECT_EQ(Browser(site).Get("/?page=Esimene&event=Logi").status, 200) << "there is room again";
}

// Each session's handler waits until the other session's runs too: it would never end if sessions
// waited for one another.
TEST(PageRuntime, SessionsRunInParallel) {
    std::barrier together(2);
    RuntimeOptions options;
    options.worker_threads = 2;
    TestSite site(std::move(options));
    site.meet = [&] { together.arrive_and_wait(); };
    std::vector<std::jthread> browsers;
    for (int i = 0; i < 2; ++i) {
        browsers.emplace_back([&] {
            Browser browser(site);
            for (int request = 1; request <= 20; ++request)
                EXPECT_EQ(browser.Get("/?page=Esimene&event=Oota").body, std::to_string(request));
        });
    }
}

// The state's counter is a plain int: the thread sanitizer sees any two requests that overlap.
TEST(PageRuntime, RequestsOfOneSessionRunOneAtATime) {
    constexpr int kThreads = 4;
    constexpr int kRequests = 150;
    RuntimeOptions options;
    options.worker_threads = 3;
    TestSite site(std::move(options));
    Browser first(site);
    first.Get("/");
    std::vector<std::jthread> threads;
    for (int i = 0; i < kThreads; ++i) {
        threads.emplace_back([&] {
            Browser browser(site);
            browser.cookie = first.cookie;
            for (int request = 0; request < kRequests; ++request) {
                const bool waits = request % 3 == 0;
                const auto response =
                    browser.Get(std::string("/?page=Esimene&event=") + (waits ? "Oota" : "Loe"));
                EXPECT_EQ(response.status, 200);
            }
        });
    }
    threads.clear();
    EXPECT_THAT(first.Get("/").body,
                HasSubstr("Esimene " + std::to_string(kThreads * kRequests + 2)));
}

}  // namespace
}  // namespace zebtell::web
