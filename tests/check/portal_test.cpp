#include <gmock/gmock.h>

#include "tests/check/check_fixture.h"
#include "tests/support/source_folder.h"

namespace zebtell::check {
namespace {

TEST_F(CheckTest, DefaultTemplatesHaveNoFaults) {
    EXPECT_EQ(Faults(DefaultTemplates()), "");
}

TEST_F(CheckTest, EveryTemplateOfThePageTableIsRead) {
    for (const CheckedPage& page : pages) {
        const std::string file(page.template_file);
        folder.Write(file, "\n<ZEB:Nothing/>");
        EXPECT_EQ(Faults(), file + ":2: unknown tag ZEB:Nothing\n");
        folder.Write(file, "");
    }
}

TEST_F(CheckTest, DatabaseThatIsNotThereHidesNoTemplateFault) {
    folder.Write("zebtell_yld.htm", "<ZEB:Company>NoField</ZEB:Company><ZEB:Nothing/>");
    for (const char* path : {"elsewhere.db", "zebtell_yld.htm"}) {
        folder.Write("ZEBTell.ini", "[DataBase]\r\nPath=" + std::string(path) + "\r\n");
        EXPECT_THAT(Faults(),
                    testing::MatchesRegex("database: .+\nzebtell_yld.htm:1: unknown tag .+\n"))
            << path;
    }
}

TEST_F(CheckTest, AllThatTheDatabaseLacksIsNamed) {
    Change(
        "DROP VIEW SQCatPriceList5; DROP VIEW SDOrderReview; DROP TABLE GDocRel;"
        "ALTER TABLE SDOrder DROP COLUMN NeedsReview;"
        "ALTER TABLE GRCompany DROP COLUMN IDEREmployee;");
    EXPECT_EQ(Faults(),
              "database: table GRCompany has no column IDEREmployee\n"
              "database: table SDOrder has no column NeedsReview\n"
              "database: there is no table GDocRel\n"
              "database: there is no table SQCatPriceList5\n");
}

TEST_F(CheckTest, FolderWithoutSettingsIsOneFault) {
    std::filesystem::remove(folder.path() / "ZEBTell.ini");
    EXPECT_EQ(Faults(), "ZEBTell.ini: the file can't be read\n");
}

struct SettingsCase {
    const char* label;
    const char* lines;  // behind [DataBase] Path, which are lines 1 and 2
    const char* faults;
};

TEST_F(CheckTest, SettingsThatMeanNothing) {
    const SettingsCase kCases[] = {
        {"all of them right",
         "Type=sqlite\nLanguage=ENG\n[WEBLog]\nLevel=debug\nLogFile=x.log\n"
         "[Session]\nBlocking=3\nTimeout=0\n[Server]\nPort=0\nRegion=lv\n; Nonsense=1\n",
         ""},
        {"words that are none of those known",
         "Type=Oracle\nLanguage=LAT\n[WEBLog]\nLevel=Verbose\n[ESTEID]\nRequired=yes\n",
         "ZEBTell.ini:3: [DataBase] Type: one of SQLite, MSSQL is needed\n"
         "ZEBTell.ini:4: [DataBase] Language: EST, ENG or LV is needed\n"
         "ZEBTell.ini:6: [WEBLog] Level: one of None, Normal, Detail, Debug is needed\n"
         "ZEBTell.ini:8: [ESTEID] Required: one of 0, 1, HTTPS is needed\n"},
        {"numbers out of range",
         "[Session]\nBlocking=-1\nTimeout=soon\n[Server]\nPort=70000\n",
         "ZEBTell.ini:4: [Session] Blocking: a whole number from 0 to 32767 is needed\n"
         "ZEBTell.ini:5: [Session] Timeout: a whole number from 0 to 32767 is needed\n"
         "ZEBTell.ini:7: [Server] Port: a whole number from 0 to 65535 is needed\n"},
        {"keys that nobody reads, and keys that stand twice",
         "[Sesion]\nBlocking=3\n[Server]\nPort=80\nPrt=8080\nport=81\n",
         "ZEBTell.ini:4: unknown setting [Sesion] Blocking\n"
         "ZEBTell.ini:7: unknown setting [Server] Prt\n"
         "ZEBTell.ini:8: [Server] port stands here again; only the first counts\n"},
        {"files that are not there",
         "[WEBLog]\nLogFile=logs/x.log\n[Server]\nTlsKey=key.pem\n",
         "ZEBTell.ini:4: [WEBLog] LogFile: there is no folder for this file\n"
         "ZEBTell.ini:6: [Server] TlsKey: TlsCertificate and TlsKey belong together\n"
         "ZEBTell.ini:6: [Server] TlsKey: the file can't be read\n"},
    };
    for (const SettingsCase& each : kCases) {
        folder.Write("ZEBTell.ini", std::string(kSettings) + each.lines);
        EXPECT_EQ(Faults(), each.faults) << each.label;
    }
    folder.Write("ZEBTell.ini", "[DataBase]\r\nType=SQLite\r\n");
    EXPECT_EQ(Faults(), "ZEBTell.ini: [DataBase] Path: a value is needed\n");
}

}  // namespace
}  // namespace zebtell::check
