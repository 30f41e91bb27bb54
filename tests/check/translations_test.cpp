#include <gmock/gmock.h>

#include "app/commands.h"
#include "tests/check/check_fixture.h"
#include "tests/support/mo_file.h"

namespace zebtell::check {
namespace {

class TranslationsTest : public CheckTest {
  protected:
    void SetUp() override {
        CheckTest::SetUp();
        std::filesystem::create_directories(folder.path() / "translations");
    }
    void Translate(const std::map<std::string, std::string>& english,
                   const std::map<std::string, std::string>& latvian) const {
        folder.Write("translations/en.mo", MoFile(english));
        folder.Write("translations/lv.mo", MoFile(latvian));
    }
};

TEST_F(TranslationsTest, EveryTextNeedsEveryLanguage) {
    folder.Write("inc.htm", "\n\n<ZEB:Text>Korv</ZEB:Text>");
    for (const char* file : {"zebtell_yld.htm", "zebtell_logon.htm"}) {
        folder.Write(file,
                     "<ZEB:Text>\n Lisa\n korvi</ZEB:Text>\n<!--#include file=\"inc.htm\"-->");
    }
    EXPECT_EQ(Faults(),
              "inc.htm:3: no translation of \"Korv\" (in English, Latvian)\n"
              "zebtell_logon.htm:1: no translation of \"Lisa korvi\" (in English, Latvian)\n"
              "zebtell_yld.htm:1: no translation of \"Lisa korvi\" (in English, Latvian)\n");
    Translate({{"Korv", "Basket"}, {"Lisa korvi", "Add"}}, {{"Lisa korvi", "Pievienot"}});
    EXPECT_EQ(Faults(), "inc.htm:3: no translation of \"Korv\" (in Latvian)\n");
    folder.Write("translations/en.mo", "damaged");
    EXPECT_THAT(Faults(), testing::StartsWith("en.mo: the catalogue can't be read (in English)\n"));
}

TEST_F(TranslationsTest, TranslationsAreReadLikeTemplates) {
    folder.Write("zebtell_yld.htm",
                 "<ZEB:Text>\n<b>Ridu <ZEB:TellRidu/></b></ZEB:Text>\n"
                 "<ZEB:Text>Nimi <ZEB:Company>Name</ZEB:Company></ZEB:Text>\n<ZEB:Nothing/>");
    Translate({{"<b>Ridu <ZEB:TellRidu/></b>", "<b>Rows</b>"},
               {"Nimi <ZEB:Company>Name</ZEB:Company>", "<ZEB:Company>Name</ZEB:Company> name"}},
              {{"<b>Ridu <ZEB:TellRidu/></b>", "Rindas: <ZEB:TellRidu/><b></b>"},
               {"Nimi <ZEB:Company>Name</ZEB:Company>", "<ZEB:Company>Nosaukums</ZEB:Company>"}});
    EXPECT_EQ(
        Faults(),
        "zebtell_yld.htm:1: the translation has not the tags of \"<b>Ridu <ZEB:TellRidu/></b>\" "
        "(in English)\n"
        "zebtell_yld.htm:3: ZEB:Company: GRCompany has no field Nosaukums (in Latvian)\n"
        "zebtell_yld.htm:4: unknown tag ZEB:Nothing\n");
}

TEST_F(TranslationsTest, MarksThatMarkNothing) {
    folder.Write("zebtell_yld.htm",
                 "<ZEB:Text> </ZEB:Text>\n<ZEB:Text>a <ZEB:Text>b</ZEB:Text></ZEB:Text>\n"
                 "<ZEB:Text><!--#include file=\"zebtell_logon.htm\"--></ZEB:Text>\n<ZEB:Text>");
    const std::map<std::string, std::string> nested = {
        {"a <ZEB:Text>b</ZEB:Text>", "a <ZEB:Text>b</ZEB:Text>"}};
    Translate(nested, nested);
    EXPECT_EQ(Faults(),
              "zebtell_yld.htm:1: ZEB:Text is empty, in another, or around an include\n"
              "zebtell_yld.htm:2: ZEB:Text is empty, in another, or around an include\n"
              "zebtell_yld.htm:3: ZEB:Text is empty, in another, or around an include\n"
              "zebtell_yld.htm:4: ZEB:Text has no end\n");
}

TEST_F(TranslationsTest, ListForTranslators) {
    folder.Write("a.htm",
                 "\n<ZEB:Text>Tere \"x\" \\ y\n z</ZEB:Text><!--#include file=\"b.htm\"-->");
    folder.Write("b.htm", "<ZEB:Text>Muu</ZEB:Text>\n<ZEB:Text>Tere \"x\" \\ y z</ZEB:Text>");
    testing::internal::CaptureStdout();
    app::PrintTexts(folder.path());
    EXPECT_THAT(testing::internal::GetCapturedStdout(),
                testing::EndsWith("\n\n#: a.htm:2\n#: b.htm:2\n"
                                  "msgid \"Tere \\\"x\\\" \\\\ y z\"\nmsgstr \"\"\n\n"
                                  "#: b.htm:1\nmsgid \"Muu\"\nmsgstr \"\"\n"));
}

}  // namespace
}  // namespace zebtell::check
