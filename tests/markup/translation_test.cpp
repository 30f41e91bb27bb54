#include <gtest/gtest.h>

#include <thread>

#include "markup/marked_text.h"
#include "markup/template_cache.h"
#include "tests/support/mo_file.h"
#include "tests/support/temp_folder.h"

namespace zebtell::markup {
namespace {

namespace fs = std::filesystem;

class TranslationTest : public testing::Test {
  protected:
    TranslationTest() {
        for (const char* folder : {"own/translations", "default/translations"}) {
            fs::create_directories(folder_.path() / folder);
        }
    }

    std::string Text(std::string_view file, std::string_view language) {
        return cache_.Get(file, language)->text();
    }
    // Behind it changes show.
    static void WaitForLook() { std::this_thread::sleep_for(std::chrono::milliseconds(1050)); }

    const TempFolder folder_;
    TemplateCache cache_{TemplateFolders{folder_.path() / "own", folder_.path() / "default"}};
};

TEST_F(TranslationTest, TextsInEachLanguage) {
    folder_.Write("default/translations/en.mo",
                  MoFile({{"Lisa korvi", "Add to \"basket\" & don't <b title=\"x\">wait</b>"},
                          {"Tere, <ZEB:Name>?A='x;y</ZEB:Name>!",
                           "<ZEB:Name>?A='x;y</ZEB:Name> isn't <ZEB:Else/>\"here\""},
                          {"Eesti <ZEB:Text>sees</ZEB:Text>", "outer"}}));
    struct Case {
        const char* label;
        const char* text;
        const char* english;
        const char* estonian;
    };
    const Case kCases[] = {
        {"white space does not matter, and quotation marks end no attribute",
         "<p title=\"<ZEB:Text>\n  Lisa\t korvi </zeb:text>\"><zeb:Text>Lisa korvi</ZEB:Text></p>",
         "<p title=\"Add to &quot;basket&quot; & don&apos;t <b title=\"x\">wait</b>\">"
         "Add to &quot;basket&quot; & don&apos;t <b title=\"x\">wait</b></p>",
         "<p title=\"\n  Lisa\t korvi \">Lisa korvi</p>"},
        {"tags inside keep their contents",
         "<ZEB:Text>Tere, <ZEB:Name>?A='x;y</ZEB:Name>!</ZEB:Text>",
         "<ZEB:Name>?A='x;y</ZEB:Name> isn&apos;t <ZEB:Else/>&quot;here&quot;",
         "Tere, <ZEB:Name>?A='x;y</ZEB:Name>!"},
        {"without a translation, empty, without an end",
         "<ZEB:Text>Muu</ZEB:Text><ZEB:Text> </ZEB:Text><ZEB:Text/><ZEB:Text>Lisa korvi",
         "Muu<ZEB:Text> </ZEB:Text><ZEB:Text/><ZEB:Text>Lisa korvi",
         "Muu<ZEB:Text> </ZEB:Text><ZEB:Text/><ZEB:Text>Lisa korvi"},
        {"one within another",
         "<ZEB:Text>Eesti <ZEB:Text>sees</ZEB:Text></ZEB:Text>",
         "outer",
         "Eesti <ZEB:Text>sees</ZEB:Text>"},
    };
    int number = 0;
    for (const Case& each : kCases) {
        const std::string file = std::to_string(++number) + ".htm";
        folder_.Write("default/" + file, each.text);
        EXPECT_EQ(Text(file, "en"), each.english) << each.label;
        EXPECT_EQ(Text(file, "et"), each.estonian) << each.label;
        EXPECT_EQ(Text(file, "lv"), each.estonian) << each.label;
    }
}

TEST_F(TranslationTest, OwnFilesWinOneByOne) {
    folder_.Write("default/page.htm", "default <!--#include file=\"inc.htm\"-->");
    folder_.Write("default/inc.htm", "<ZEB:Text>Korv</ZEB:Text>, <ZEB:Text>Hind</ZEB:Text>");
    folder_.Write("default/translations/en.mo", MoFile({{"Korv", "Cart"}, {"Hind", "Price"}}));
    EXPECT_EQ(Text("page.htm", "en"), "default Cart, Price");

    folder_.Write("own/inc.htm", "own <ZEB:Text>Korv</ZEB:Text>, <ZEB:Text>Hind</ZEB:Text>");
    folder_.Write("own/translations/en.mo", MoFile({{"Korv", "Basket"}}));
    WaitForLook();
    EXPECT_EQ(Text("page.htm", "en"), "default own Basket, Price");

    folder_.Write("own/translations/en.mo", "no catalogue");
    WaitForLook();
    EXPECT_EQ(Text("page.htm", "en"), "default own Cart, Price") << "the broken one is left out";
    fs::remove(folder_.path() / "own/inc.htm");
    WaitForLook();
    EXPECT_EQ(Text("page.htm", "en"), "default Cart, Price");
}

}  // namespace
}  // namespace zebtell::markup
