#include <gmock/gmock.h>

#include <chrono>
#include <filesystem>

#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;

using BrokenSurroundings = PortalTest;

TEST_F(BrokenSurroundings, MissingTemplate) {
    Browser mari = MariLoggedOn();
    std::filesystem::remove(folder.path() / "templates/zebtell_info.htm");
    EXPECT_THAT(mari.Get("KInfo"),
                HasSubstr("<p><b>ZEB/Server error #35 (53)</b></p>\r\n"
                          "<p>File not found: zebtell_info.htm</p>"));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[kaubad"));
    EXPECT_THAT(Log(), HasSubstr("mari error #35 (53)\r\nFile not found: zebtell_info.htm\r\n"));
}

TEST_F(BrokenSurroundings, DamagedTemplates) {
    Browser mari = MariLoggedOn();
    folder.Write("templates/zebtell_info.htm",
                 "<ZEB:GRArticle>Code <ZEB:WEBUser>shown</ZEB:Nothing> <ZEB: > [end]");
    EXPECT_THAT(mari.Get("KInfo"), HasSubstr("shown"));
    EXPECT_THAT(mari.page(), HasSubstr("[end]"));

    // A block that never moves its query on would repeat without end.
    folder.Write("templates/zebtell_yld.htm",
                 "<ZEB:Query>GRTax;;;list</ZEB:Query><ZEB:GRTax.Row>again</ZEB:GRTax.Row>");
    const auto start = std::chrono::steady_clock::now();
    EXPECT_THAT(mari.Get("Yld"), HasSubstr("zebtell_yld.htm"));
    EXPECT_THAT(mari.page(), HasSubstr("ZEB/Server error #5 (5)"));
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(30));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[kaubad"));
}

TEST_F(BrokenSurroundings, DatabaseMissingOrDamaged) {
    const auto database = folder.path() / "company.db";
    portal.reset();
    std::filesystem::rename(database, folder.path() / "away.db");
    const auto expect_no_service = [&] {
        Browser browser = NewBrowser();
        EXPECT_THAT(browser.LogOn("mari", "mari-sala"),
                    HasSubstr("(Teenus ei ole praegu kättesaadav, palun proovige mõne aja"));
        EXPECT_EQ(browser.Ask("/healthz", "GET", "").status, 503);
    };
    Start(kUsualSettings);
    expect_no_service();
    EXPECT_FALSE(std::filesystem::exists(database)) << "an empty database was made";
    folder.Write("company.db", "this is no database, " + std::string(5000, 'x'));
    Start(kUsualSettings);
    expect_no_service();

    // The database comes back: no restart is needed.
    std::filesystem::rename(folder.path() / "away.db", database);
    EXPECT_THAT(MariLoggedOn().Get("Kaubainfo"), HasSubstr("[kaubad"));
    EXPECT_EQ(NewBrowser().Ask("/healthz", "GET", "").status, 200);
}

// Nothing listens at the port. Whoever tries to log on is not blocked for it.
TEST_F(BrokenSurroundings, ServerOfTheDatabaseMissing) {
    const std::string driver = std::string("Driver=") + ZEBTELL_FREETDS_ODBC;
    StartOn("Type=MSSQL\r\nPath=" + driver + ";Server=127.0.0.1;Port=1;UID=portal;PWD=x",
            "[Session]\r\nBlocking=1\r\nTimeout=5\r\n");
    Browser browser = NewBrowser();
    for (int i = 0; i < 3; ++i) {
        EXPECT_THAT(browser.LogOn("mari", "mari-sala"),
                    HasSubstr("(Teenus ei ole praegu kättesaadav, palun proovige mõne aja"));
    }
    EXPECT_EQ(browser.Ask("/healthz", "GET", "").status, 503);
}

TEST_F(BrokenSurroundings, LogThatCannotBeWritten) {
    Start("LogFile=/nowhere/at/all.log\r\nLevel=Debug\r\n");
    EXPECT_THAT(MariLoggedOn().Get("Kaubainfo"), HasSubstr("[kaubad"));
    std::filesystem::create_directory(folder.path() / "folder.log");
    Start("LogFile=" + (folder.path() / "folder.log").string() + "\r\n");
    EXPECT_THAT(MariLoggedOn().Get("Kaubainfo"), HasSubstr("[kaubad"));
}

TEST_F(BrokenSurroundings, NonsenseInTheSettings) {
    Start("[Session\r\nBlocking==\"\r\n\xFF\xFE\x01[[]]\r\nTimeout=1e9\r\n[Mail]\r\nPort=-\r\n" +
          std::string(100000, '=') + "\r\n");
    EXPECT_THAT(MariLoggedOn().Get("Kaubainfo"), HasSubstr("[kaubad"));
    // A changed file counts for the next new session.
    folder.Write(
        "ZEBTell.ini",
        "[DataBase]\r\nPath=" + (folder.path() / "company.db").string() + "\r\nLanguage=EN\r\n");
    EXPECT_THAT(NewBrowser().LogOn("mari", "wrong"), HasSubstr("(Invalid user name or password!)"));
}

TEST_F(BrokenSurroundings, StatusIsForThisMachine) {
    const auto metrics = NewBrowser().Ask("/metrics", "GET", "");
    EXPECT_EQ(metrics.status, 200);
    EXPECT_THAT(metrics.body, HasSubstr("\nzebtell_requests_total "));
    EXPECT_EQ(NewBrowser().Ask("/company.db", "GET", "").status, 404);
    EXPECT_EQ(NewBrowser().Ask("/static/../ZEBTell.ini", "GET", "").status, 400);
}

}  // namespace
}  // namespace zebtell
