#include <gmock/gmock.h>

#include <set>

#include "app/pages.h"
#include "tests/portal/html_names.h"
#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::IsSupersetOf;

// Each tries to become an element or attribute "evil", or to have the template engine show
// "evilshown".
const std::string kTexts[] = {
    "<evil>\"><evil>'><evil>`><evil>",
    "\" evil=\"1' evil='1 evil=1 x/evil=",
    "</textarea></title></script></style>--><evil>",
    "<ZEB:WEBUser>evilshown</ZEB:WEBUser><ZEB:SDOrder/><zeb:SaveValue>",
    "<!--#include file=\"inc_nav.htm\"--><evil>",
    "&lt;evil&gt;&#60;evil&#62;&quot; evil=&quot;",
    "javascript:evil()",
    "\xC0\xBC"
    "evil\xC0\xBE \xE0\x80\xBC"
    "evil \xF8\xE2\x80\xA8\xE2\x80\xAE<evil\xE2\x80>",
    std::string("<\0evil>\0<evil\0>", 16),
};

// The portal's own templates over a company whose every text is hostile.
class HarmlessText : public PortalTest {
  protected:
    void SetUp() override {
        PortalTest::SetUp();
        std::filesystem::remove_all(folder.path() / "templates");
        std::filesystem::copy(SourceFolder() / "templates",
                              folder.path() / "templates",
                              std::filesystem::copy_options::recursive);
    }

    // Counts for the next session.
    void Speak(const std::string& language) {
        folder.Write("ZEBTell.ini",
                     "[DataBase]\r\nPath=" + (folder.path() / "company.db").string() +
                         "\r\nLanguage=" + language + "\r\n[WEBLog]\r\nLevel=None\r\n");
    }

    // The record's key and the text behind it, for every text that is not what the portal works
    // by.
    void Plant(const std::string& text) {
        const std::string columns = company().Run(
            "SELECT m.name || '.' || p.name FROM sqlite_master m JOIN pragma_table_info(m.name) p "
            "WHERE m.type = 'table' AND p.type LIKE 'NVARCHAR%'");
        std::string hex;
        for (const unsigned char byte : text)
            hex += "0123456789ABCDEF"[byte >> 4], hex += "0123456789ABCDEF"[byte & 15];
        std::string script;
        for (const std::string_view column : base::Split(base::Trimmed(columns), '\n')) {
            if (kKept.contains(std::string(column)) || column.empty()) continue;
            const std::size_t dot = column.find('.');
            script.append("UPDATE ").append(column.substr(0, dot)).append(" SET ");
            script.append(column.substr(dot + 1)).append(" = ID || CAST(X'" + hex + "' AS TEXT);");
        }
        company().Run(script);
    }

    void Check(const Browser& browser, const std::string& where) {
        const std::string& page = browser.page();
        for (const std::string& name : HtmlNames::Of(page)) {
            const bool evil = name.find("evil") != std::string::npos || name == "javascript";
            EXPECT_FALSE(evil) << name << " on " << where << "\n" << (evil ? page : "");
        }
        for (std::size_t at = 0; (at = page.find("evilshown", at)) != std::string::npos; ++at) {
            EXPECT_EQ(page.substr(at - 4, 4), "&gt;") << where;
        }
        EXPECT_TRUE(base::IsValidUtf8(page)) << where;
        EXPECT_EQ(page.find('\0'), std::string::npos) << where;
        if (page.find("evil") != std::string::npos) shown_.insert(where.substr(0, where.find('&')));
    }

    void Walk(const std::string& text) {
        Browser mari = MariLoggedOn();
        const auto get = [&](const std::string& page) {
            mari.Get(page);
            Check(mari, page);
        };
        const auto post = [&](const std::string& page, Browser::Fields fields) {
            mari.Post(page, fields);
            Check(mari, page);
        };
        const std::string coded = http::EncodeComponent(text);
        get("Kaubainfo");
        post("Kaubainfo&event=Hinnakiri",
             {{"ZEBInText", text}, {"save_" + text, text}, {"Find_GRArticle", text}});
        post("Kaubainfo&event=Otsing", {{"ZEBInText", text}});
        post("Kaubainfo&event=Hinnakiri", {{"Combo_GRArticleCat", text}, {"DataOrder", text}});
        post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", ""}, {"Combo_GRArticleCat", "1"}});
        post("Kaubainfo&event=Lisamine",
             {{"ID_1101", "2"}, {"ID_1102", text}, {"Code_f1", text}, {"Quantity_f1", text}});
        post("Kaubainfo&event=Tellimus",
             {{"Change_Quant", "1"},
              {"Row_1", text},
              {"Expl_1", text},
              {"EF_Explanation_1", text},
              {"SDOrder." + text, text}});
        post("Kaubainfo&event=Tellimus",
             {{"Change_Quant", "1"}, {"Expl_1", text}, {"SDOrder.Explanation", text}});
        get("Kaubainfo&event=" + coded);
        get("Kaubainfo&event=ID_" + coded);
        get("Kaubainfo&event=ID_1101");
        get("KInfo&event=" + coded + "&ID=101");
        get("Tellimus&event=ID_" + coded);
        get("Tellimus&event=ID_501");
        get("Kinnitus");
        post("Kinnitus&event=LisaTellimus",
             {{"ZEB_But_Vormista", text},
              {"ZEB_Nimi", text},
              {"ZEB_Aadress", text},
              {"ZEB_Komment", text}});
        for (const host::Page& page : app::PortalPages()) {
            if (page.name != "Logout") get(std::string(page.name));
        }
        mari.LogOn(text, text);
        Check(mari, "log-on refused");
        get(coded);
        mari.GetPath("/" + coded);
        Check(mari, "no such file");
    }

    const std::set<std::string> kKept = {
        "SYUser.Name", "SYUser.PasswordHash", "GDocument.Kind", "GDocument.DocKey"};
    std::set<std::string> shown_;  // the pages that had some of the text
};

TEST_F(HarmlessText, NoTextBecomesMarkupOnAnyPage) {
    for (const char* language : {"EST", "EN", "LV"}) {
        Speak(language);
        shown_.clear();
        for (const std::string& text : kTexts) {
            SCOPED_TRACE(language + (" " + text));
            Plant(text);
            Walk(text);
            if (HasFailure()) return;  // one page is enough to look at
        }
        EXPECT_THAT(shown_,
                    IsSupersetOf({"Kaubainfo",
                                  "KInfo",
                                  "Kasutaja",
                                  "Kinnitatud",
                                  "Kinnitus",
                                  "Koostamine",
                                  "Lisamine",
                                  "Tellimus"}));
    }
}

// What the reading of pages above is worth.
TEST(HtmlNames, SeesWhatBrowsersSee) {
    const auto names = [](std::string_view html) {
        std::string all;
        for (const std::string& name : HtmlNames::Of(html)) all += name + " ";
        return all;
    };
    EXPECT_EQ(names("<p class=a b='>' C = \"x\"d>t</p><!-- <b> --><br/>x<i"),
              "p p@class p@b p@c p@d p br i ");
    EXPECT_EQ(names("<textarea><b></textarea><i>< b><!b><a/evil=1>"),
              "textarea textarea i a a@evil ");
    EXPECT_EQ(names("<title>a</title ><a href=\" javaScript:x\">"),
              "title title a a@href javascript ");
}

}  // namespace
}  // namespace zebtell
