#include <gmock/gmock.h>
#include <sys/stat.h>

#include <thread>

#include "base/runtime_error.h"
#include "host/errors.h"
#include "host/log.h"
#include "host/plain_pages.h"
#include "tests/host/session.h"

namespace zebtell::host {
namespace {

TEST(RequestCycle, InitialState) {
    TestSession s;
    const SessionState& state = *s.state;
    EXPECT_EQ(state.documents.Orders.From.ToIso(), "2026-11-01");
    EXPECT_EQ(state.documents.Invoices.To.ToIso(), "2026-11-21");
    EXPECT_THAT(state.templates.PriceQueryText, testing::StartsWith("select s5.*"));
    EXPECT_TRUE(state.initialised);
    EXPECT_EQ(s.Log(), "2026-11-21 14:05:09[-] ++ZEBTell+initialized++\r\n");
}

TEST(RequestCycle, EntriesByLevel) {
    const auto log_of = [](const std::string& level) {
        TestSession s("[WEBLog]\nLevel=" + level);
        s.request.query_string = "page=Logon";
        s.Ask(WebClass_BeginRequest);
        s.Ask(WebClass_EndRequest);
        WebClass_Terminate(*s.state);
        return s.Log();
    };
    EXPECT_EQ(log_of("None"), "");
    EXPECT_EQ(log_of("Normal"),
              "2026-11-21 14:05:09[-] ++ZEBTell+initialized++\r\n"
              "2026-11-21 14:05:09[-] --ZEBTell-terminated--\r\n");
    EXPECT_EQ(log_of("Detail"),
              "2026-11-21 14:05:09[][-] ++ZEBTell+initialized++\r\n"
              "2026-11-21 14:05:09[77][-] --ZEBTell-terminated--\r\n");
    EXPECT_EQ(log_of("Debug"),
              "2026-11-21 14:05:09[][-] ++ZEBTell+initialized++\r\n"
              "2026-11-21 14:05:09[77][-] +Req+beg+ page=Logon\r\n"
              "2026-11-21 14:05:09[77][-] -Req-end- page=Logon\r\n"
              "2026-11-21 14:05:09[77][-] --ZEBTell-terminated--\r\n");
}

TEST(RequestCycle, LogThatCannotBeWrittenStopsNothing) {
    TestSession s("[WEBLog]\nLogFile=/nowhere/at/all.log\nLevel=Debug\n");
    s.Ask(WebClass_BeginRequest);
    s.Ask(Raamistik_Respond);
    EXPECT_EQ(s.templates_written, 1);
}

TEST(RequestCycle, EntriesOfSeveralWritersStayWhole) {
    TestSession s;
    const auto settings = s.settings.Current();
    const std::string text(200, 'x');
    const auto write = [&] {
        for (int i = 0; i < 200; ++i) {
            WriteLogEntry(*settings, {"1", true, true}, s.now, text, log_Normal);
        }
    };
    std::thread a(write), b(write);
    a.join();
    b.join();
    const std::string line = "2026-11-21 14:05:09[G] " + text + "\r\n";
    std::string expected = "2026-11-21 14:05:09[-] ++ZEBTell+initialized++\r\n";
    for (int i = 0; i < 400; ++i) expected += line;
    EXPECT_EQ(s.Log(), expected);
}

TEST(Guard, TellsANewSessionFromALoggedOffUser) {
    TestSession s;
    s.Ask(CheckLogon);
    EXPECT_EQ(s.response.redirect_address(), "?page=Logon");
    EXPECT_EQ(s.state->Message, "Sessioon katkestatud - sisenege uuesti!");
    s.state->logon.UserName = "mari";
    s.Ask(CheckLogon);
    EXPECT_EQ(s.state->Message, "Palume uuesti siseneda!");
    EXPECT_THAT(s.Log(), testing::HasSubstr("Forced to logon - timeout or bad link\r\n"));
    EXPECT_THAT(s.Log(), testing::HasSubstr("Forced to logon - already logged out\r\n"));
    s.state->logon.LoggedOn = true;
    s.Ask(CheckLogon);
    EXPECT_EQ(s.response.redirect_address(), "");
}

TEST(ErrorPage, ByteForByte) {
    TestSession s;
    s.runtime.write_template = [](web::Call& call) {
        call.response.Write("half a page");
        throw base::RuntimeError(base::errors::kStatementFailed, "near &quot;x&quot;");
    };
    s.Ask(Raamistik_Respond);
    EXPECT_EQ(s.response.body(),
              "<html>\r\n"
              "<head><title>ZEB/Server error</title></head>\r\n"
              "<body>\r\n"
              "<p><b>ZEB/Server error #80040E14 (-2147217900)</b></p>\r\n"
              "<p>near &quot;x&quot;</p>\r\n"
              "<hr noshade size=1>\r\n"
              "<p>Please contact with system administrator</p>\r\n"
              "</body>\r\n");
    EXPECT_THAT(s.Log(),
                testing::HasSubstr("[-] [No user] error #80040E14 (-2147217900)\r\n"
                                   "near &quot;x&quot;\r\n"));
}

TEST(ErrorPage, ForeignExceptionsShowAsText) {
    TestSession s;
    s.Ask([](SessionState& state, web::Call& call) {
        WriteErrorPage(state, call, std::out_of_range("<script>"));
        EXPECT_THAT(call.response.body(), testing::HasSubstr("<p>&lt;script&gt;</p>"));
        WriteErrorPage(state, call, base::RuntimeError(5));
        EXPECT_THAT(call.response.body(), testing::HasSubstr("ZEB/Server error #5 (5)</b></p>"));
    });
}

TEST(HandlerError, IsOneLineOfTheDetailedLog) {
    TestSession s("[WEBLog]\nLevel=Detail\n");
    const bool done = Guarded(*s.state, "Yld_Respond", [] {
        throw base::RuntimeError(5, "bad\r\n2026-11-21 14:05:09[1][U] evil");
    });
    EXPECT_FALSE(done);
    EXPECT_THAT(
        s.Log(),
        testing::EndsWith("[][-] Yld_Respond error:bad  2026-11-21 14:05:09[1][U] evil\r\n"));
}

TEST(FatalError, LogsAndLogsOff) {
    TestSession s;
    s.state->logon.LoggedOn = true;
    s.state->logon.UserName = "mari";
    s.Ask([](SessionState& state, web::Call& call) {
        bool send_default = true;
        WebClass_FatalErrorResponse(
            state, call, base::RuntimeError(13, "Type mismatch"), send_default);
        EXPECT_TRUE(send_default);
    });
    EXPECT_THAT(s.Log(), testing::HasSubstr("mari [fatal] error #D (13)\r\nType mismatch\r\n"));
    EXPECT_FALSE(s.state->logon.LoggedOn);
    s.Ask(CheckLogon);
    EXPECT_EQ(s.state->Message, "Palume uuesti siseneda!");
}

TEST(SessionDictionary, IgnoresCase) {
    TestSession s;
    SessionDictionary(*s.state)["Key"] = "1";
    EXPECT_EQ(SessionDictionary(*s.state).find("kEY")->second, "1");
}

}  // namespace
}  // namespace zebtell::host
