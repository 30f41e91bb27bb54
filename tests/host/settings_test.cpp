#include "host/settings.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "host/ini_file.h"
#include "host/server_settings.h"
#include "tests/support/temp_folder.h"

namespace zebtell::host {
namespace {

struct SettingsTest : testing::Test {
    TempFolder folder;

    Settings Load(std::string_view ini) {
        folder.Write("ZEBTell.ini", ini);
        return LoadSettings(folder.path());
    }
};

TEST_F(SettingsTest, MissingFileGivesTheDefaults) {
    const Settings s = LoadSettings(folder.path());
    EXPECT_EQ(s.Path, "");
    EXPECT_EQ(static_cast<int>(s.Type), 1);
    EXPECT_EQ(s.Language, "EST");
    EXPECT_EQ(s.DispName, "Külaline");
    EXPECT_EQ(s.UserID, "WebGuest");
    EXPECT_EQ(s.PassWord, "");
    EXPECT_EQ(s.LogFile, (folder.path() / "ZEBTell.log").string());
    EXPECT_EQ(s.Level, log_Normal);
    EXPECT_EQ(s.Blocking, 0);
    EXPECT_EQ(s.Timeout, 0);
    EXPECT_FALSE(s.ESTEID.IsOn);
    EXPECT_EQ(s.Mail.Port, 25);
}

// A folder in the file's place: reading it fails, which a missing file does not.
TEST_F(SettingsTest, FailureAtTheFirstKeysEndsTheLoading) {
    std::filesystem::create_directory(folder.path() / "ZEBTell.ini");
    const Settings s = LoadSettings(folder.path());
    EXPECT_EQ(s.Language, "EST");
    EXPECT_EQ(s.DispName, "");
    EXPECT_EQ(s.LogFile, "");
    EXPECT_EQ(s.Level, log_None);
    EXPECT_EQ(s.Mail.Port, 0);
}

TEST_F(SettingsTest, EveryRuleOfAKey) {
    const auto level = [&](std::string_view word) {
        return Load("[WEBLog]\nLevel=" + std::string(word)).Level;
    };
    EXPECT_EQ(level("none"), log_None);
    EXPECT_EQ(level("DETAIL"), log_Detail);
    EXPECT_EQ(level("Debug"), log_Debug);
    EXPECT_EQ(level("Normal"), log_Normal);
    EXPECT_EQ(level("3"), log_Normal);

    const auto type = [&](std::string_view word) {
        return static_cast<int>(Load("[DataBase]\nType=" + std::string(word)).Type);
    };
    EXPECT_EQ(type("mssql"), 2);
    EXPECT_EQ(type("Oracle"), 1);

    const auto blocking = [&](std::string_view word) {
        return Load("[Session]\nTimeout=7\nBlocking=" + std::string(word)).Blocking;
    };
    EXPECT_EQ(blocking("3"), 3);
    EXPECT_EQ(blocking("-5"), 0);
    EXPECT_EQ(blocking("many"), 0);
    EXPECT_EQ(blocking("40000"), 0);
    EXPECT_EQ(blocking("2,5"), 2);

    const auto port = [&](std::string_view word) {
        return Load("[Mail]\nPort=" + std::string(word)).Mail.Port;
    };
    EXPECT_EQ(port("2525"), 2525);
    EXPECT_EQ(port(""), 25);
    EXPECT_EQ(port("70000"), 0);
    // A bad number does not keep the settings behind it from being read.
    EXPECT_EQ(Load("[Session]\nBlocking=x\nTimeout=7").Timeout, 7);
}

TEST_F(SettingsTest, IdCardKeysAreReadOnlyWhileItIsOn) {
    const std::string keys = "\nAuthMode=A\nUserID=U\nPassword=P\nOCSP=1";
    const auto off = Load("[ESTEID]\nRequired=0" + keys).ESTEID;
    EXPECT_FALSE(off.IsOn);
    EXPECT_EQ(off.UserID, "");
    const auto required = Load("[ESTEID]\nRequired=1" + keys).ESTEID;
    EXPECT_TRUE(required.IsOn && required.IsRequired && !required.OverHttps && required.OCSP);
    const auto https = Load("[ESTEID]\nRequired=HTTPS" + keys).ESTEID;
    EXPECT_TRUE(https.IsOn && !https.IsRequired && https.OverHttps);
    EXPECT_EQ(https.UserID, "U");
    const auto lower = Load("[ESTEID]\nRequired=https" + keys).ESTEID;
    EXPECT_TRUE(lower.IsOn && !lower.IsRequired && !lower.OverHttps);
    const auto ocsp = [&](const std::string& word) {
        return Load("[ESTEID]\nRequired=yes\nOCSP=" + word).ESTEID.OCSP;
    };
    EXPECT_TRUE(ocsp("-1"));
    EXPECT_FALSE(ocsp("0") || ocsp("") || ocsp("true"));
}

TEST_F(SettingsTest, LanguagesByTheirFirstTwoLetters) {
    EXPECT_EQ(Load("[DataBase]\nLanguage=english").language(), UserLanguage::kEnglish);
    EXPECT_EQ(Load("[DataBase]\nLanguage=lv").language(), UserLanguage::kLatvian);
    EXPECT_EQ(Load("[DataBase]\nLanguage=LVA").region().name, "lv");
    EXPECT_EQ(Load("[DataBase]\nLanguage=RU").language(), UserLanguage::kEstonian);
    EXPECT_EQ(Load("[DataBase]\nLanguage=EST\n[Server]\nRegion=en").region().name, "en");
}

TEST_F(SettingsTest, FileFormat) {
    struct Case {
        const char* what;
        std::string text;
        std::string expected;
    };
    const Case cases[] = {
        {"plain", "[S]\nK=v", "v"},
        {"letter case, blanks, CRLF", "[ s ]\r\n  k \t= v w \r\n", "v w"},
        {"quotes around", "[S]\nK=\" v \"", " v "},
        {"apostrophes around", "[S]\nK='v'", "v"},
        {"one quote stays", "[S]\nK=\"v", "\"v"},
        {"comment line", "[S]\n;K=no\nK=v", "v"},
        {"comment mark in a value stays", "[S]\nK=a;b", "a;b"},
        {"first key counts", "[S]\nK=v\nK=w", "v"},
        {"first section counts", "[S]\nA=1\n[T]\nK=t\n[S]\nK=late", ""},
        {"other section", "[T]\nK=t", ""},
        {"byte order mark", "\xEF\xBB\xBF[S]\nK=v", "v"},
        {"8-bit text", "[S]\nK=K\xFClaline", "Külaline"},
        {"UTF-8 text", "[S]\nK=Külaline", "Külaline"},
        {"cut behind 253 characters", "[S]\nK=" + std::string(300, 'x'), std::string(253, 'x')},
        {"cut by characters, not bytes",
         "[S]\nK=" + std::string(252, 'x') + "\u00FC\u00FC",
         std::string(252, 'x') + "\u00FC"},
        {"cut 8-bit text alike",
         "[S]\nK=" + std::string(252, 'x') + "\xFC\xFC",
         std::string(252, 'x') + "\u00FC"},
        {"nonsense lines", "=\n[\n]x\n[S\n===\n[S]\nK=v", "v"},
    };
    for (const Case& c : cases) {
        folder.Write("any.ini", c.text);
        clsIniFile file;
        file.FileName = folder.path() / "any.ini";
        EXPECT_EQ(file.Value("S", "K"), c.expected) << c.what;
    }
}

TEST_F(SettingsTest, WritingKeepsTheRest) {
    clsIniFile file;
    folder.Write("old.ini", "; why\n[S]\n  K = 1\n\n  odd line\n");
    file.FileName = folder.path() / "old.ini";
    file.SetValue("S", "L", "2");
    EXPECT_EQ(folder.Read("old.ini"), "; why\r\n[S]\r\n  K = 1\r\n\r\n  odd line\r\nL=2\r\n");
    file.FileName = folder.path() / "new.ini";
    file.Section = "S";
    file.SetValue("", "K", "1");
    file.SetValue("T", "L", "2");
    file.SetValue("", "M", "3");
    file.SetValue("s", "K", "4");
    EXPECT_EQ(folder.Read("new.ini"), "[S]\r\nK=4\r\nM=3\r\n[T]\r\nL=2\r\n");
    EXPECT_EQ(file.Value("", "M"), "3");
}

TEST_F(SettingsTest, ServerSectionRefusesNonsense) {
    folder.Write("ZEBTell.ini", "[Server]\nPort=9000\nTrustedProxies=127.0.0.1, 10.0.0.0/8\n");
    const ServerSettings good = LoadServerSettings(folder.path());
    EXPECT_EQ(good.Port, 9000);
    EXPECT_EQ(good.TrustedProxies, (std::vector<std::string>{"127.0.0.1", "10.0.0.0/8"}));
    EXPECT_EQ(good.TemplateFolder, folder.path());
    for (const char* bad : {"Port=80x",
                            "Port=99999",
                            "SessionMinutes=0",
                            "BasePath=portal",
                            "BasePath=//other.example",
                            "BasePath=/a\">b",
                            "Threads=-1",
                            "TlsKey=key.pem"}) {
        folder.Write("ZEBTell.ini", "[Server]\n" + std::string(bad));
        EXPECT_THROW(LoadServerSettings(folder.path()), base::RuntimeError) << bad;
    }
}

}  // namespace
}  // namespace zebtell::host
