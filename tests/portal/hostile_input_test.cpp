#include <gmock/gmock.h>

#include <chrono>

#include "markup/escape.h"
#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

using HostileInput = PortalTest;

TEST_F(HostileInput, QuantitiesAsPeopleTypeThem) {
    struct Case {
        const char* typed;
        const char* row;  // the basket row afterwards
    };
    const Case cases[] = {
        {"1,5", "(1|KR-1|1,5|12,75|"},
        {"1.5", "(1|KR-1|1,5|12,75|"},
        {"1 000", "(1|KR-1|1000|8500,00|"},
        {"1\xC2\xA0"
         "000",
         "(1|KR-1|1000|8500,00|"},
        {"", "(1|KR-1|0|0,00|"},
        {"2,00049", "(1|KR-1|2|17,00|"},
        {"abc", "(1|KR-1|7|59,50|"},
        {"-5", "(1|KR-1|7|59,50|"},
        {"1e999", "(1|KR-1|7|59,50|"},
        {"1e300", "(1|KR-1|7|59,50|"},
        {"nan", "(1|KR-1|7|59,50|"},
        {"0x10", "(1|KR-1|7|59,50|"},
        {"1,2,3", "(1|KR-1|7|59,50|"},
    };
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    for (const Case& c : cases) {
        mari.Post("Kaubainfo&event=Tellimus", {{"Order_Clear", "1"}});
        mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "7"}});
        mari.Post("Kaubainfo&event=Tellimus", {{"Change_Quant", "1"}, {"Row_1", c.typed}});
        EXPECT_THAT(mari.page(), HasSubstr(c.row)) << c.typed;
    }
}

TEST_F(HostileInput, CommentsAreStoredAndShownAsTyped) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
    mari.Post("Kinnitus&event=LisaTellimus",
              {{"ZEB_But_Vormista", "1"}, {"ZEB_Komment", "O'Ring \"\xF0\x9F\x94\xA9\" <b>&lt;"}});
    EXPECT_EQ(company().Run("SELECT Explanation FROM SDOrder WHERE Number = 7004"),
              "O'Ring \"\xF0\x9F\x94\xA9\" <b>&lt;\n");
    EXPECT_THAT(mari.page(), HasSubstr("comment=O'Ring \"\xF0\x9F\x94\xA9\" &lt;b&gt;&lt; sum="));
}

TEST_F(HostileInput, ApostrophesAreSearchedFor) {
    for (const char* user : {"mari", "teine"}) {
        Browser browser = NewBrowser();
        browser.LogOn(user, "mari-sala");
        browser.Get("Kaubainfo");
        // Nobody else's price list has the ring.
        const char* const found = user == std::string("mari") ? "rows=1 " : "rows=0 ";
        for (const char* typed : {"O'Ring", "o'r", "'", "O?R*"}) {
            for (const char* category : {"0", "2"}) {
                browser.Post("Kaubainfo&event=Hinnakiri",
                             {{"ZEBInText", typed}, {"Combo_GRArticleCat", category}});
                EXPECT_THAT(browser.page(), HasSubstr(found)) << user << typed << category;
            }
            EXPECT_THAT(browser.Post("Kaubainfo&event=Otsing", {{"ZEBInText", typed}}),
                        HasSubstr(found))
                << user << typed;
        }
    }
}

// A request that a text can be put into, in the place of "@".
struct Way {
    const char* label;
    const char* page;
    std::vector<std::pair<std::string, std::string>> fields;  // none: a link
    bool shows_numbers = false;                               // which then are no keys
};

class Ways : public PortalTest {
  protected:
    // The page that a text leads to. What was typed is masked, since pages show it.
    std::string Answer(Browser& browser, const Way& way, const std::string& text) {
        const auto with_text = [&](const std::string& in) { return base::Replaced(in, "@", text); };
        const auto prepare = [&browser](const char* event, const char* body) {
            browser.Ask(Browser::Address(event), "POST", body);
        };
        prepare("Kaubainfo&event=Otsing", "ZEBInText=");
        prepare("Kaubainfo&event=Tellimus", "Order_Clear=1");
        prepare("Kaubainfo&event=Lisamine", "ID_1101=2");
        std::string body;
        for (const auto& [name, value] : way.fields) {
            body +=
                (body.empty() ? "" : "&") + Browser::Encoded({{with_text(name), with_text(value)}});
        }
        const std::string page = base::Replaced(way.page, "@", http::EncodeComponent(text));
        way.fields.empty() ? browser.Get(page) : browser.PostBody(page, body);
        std::string answer = std::to_string(browser.status()) + browser.page();
        if (const std::size_t key = answer.find("key="); key != std::string::npos) {
            answer.erase(key, 36);  // made anew with each order
        }
        const std::string cut(base::FirstCharacters(text, 40));
        for (const std::string& form : {text, markup::Escaped(text), markup::Escaped(cut)}) {
            answer = base::ReplacedNoCase(answer, form, "?");
        }
        return answer;
    }
};

const Way kWays[] = {
    {"search", "Kaubainfo&event=Otsing", {{"ZEBInText", "@"}}},
    {"search in the list", "Kaubainfo&event=Hinnakiri", {{"ZEBInText", "@"}}},
    {"search in a category",
     "Kaubainfo&event=Hinnakiri",
     {{"ZEBInText", "@"}, {"Combo_GRArticleCat", "1"}}},
    {"category", "Kaubainfo&event=Hinnakiri", {{"Combo_GRArticleCat", "@"}}},
    {"order", "Kaubainfo&event=Hinnakiri", {{"DataOrder", "@"}}},
    {"saved value", "Kaubainfo&event=Hinnakiri", {{"save_x", "@"}, {"save_@", "@"}}, true},
    {"code", "Kaubainfo&event=Lisamine", {{"Code_f1", "@"}, {"Quantity_f1", "1"}}},
    {"quantity", "Kaubainfo&event=Lisamine", {{"ID_1102", "@"}}, true},
    {"price", "Kaubainfo&event=Lisamine", {{"ID_1102", "1"}, {"Price_1102", "@"}}, true},
    {"line", "Kaubainfo&event=Lisamine", {{"ID_@", "1"}}},
    {"price's name", "Kaubainfo&event=Lisamine", {{"ID_1102", "1"}, {"Price_@", "1"}}},
    {"row",
     "Kaubainfo&event=Tellimus",
     {{"Change_Quant", "1"}, {"Row_1", "@"}, {"Row_@", "1"}},
     true},
    {"row's field",
     "Kaubainfo&event=Tellimus",
     {{"Change_Quant", "1"}, {"EF_@_1", "@"}, {"EF_Explanation_1", "@"}},
     true},
    {"header", "Kaubainfo&event=Tellimus", {{"Change_Quant", "1"}, {"SDOrder.@", "1"}}},
    {"header's value",
     "Kaubainfo&event=Tellimus",
     {{"Change_Quant", "1"}, {"SDOrder.IDGRCompContPerson", "@"}}},
    {"header at the end",
     "Kinnitus&event=LisaTellimus",
     {{"ZEB_But_Tagasi", "1"}, {"SDOrder.@", "1"}, {"SDOrder.GRCompany.@", "1"}}},
    {"article to add", "Lisamine&event=Lisamine", {{"IDGRArticle", "@"}, {"ZEBInQuant", "1"}}},
    {"line to add", "Lisamine&event=ID_@", {}},
    {"line of the list", "Kaubainfo&event=ID_@", {}},
    {"turning", "Kaubainfo&event=Navigate&Nav=@", {}},
    {"any event", "Kaubainfo&event=@", {}},
    {"article", "KInfo&event=Show&ID=@", {}},
    {"order to show", "Tellimus&event=ID_@", {}},
    {"order to change", "Kinnitus&event=ID_@", {}},
    {"order to copy", "Kinnitus&event=COPY_@", {}},
    {"row to take out", "Koostamine&event=DEL_@", {}},
};

// Questions about another customer's data with a right and a wrong guess in the place of "#".
const struct {
    const char* text;
    const char* right;
    const char* wrong;
} kQuestions[] = {
    {"x' OR EXISTS(SELECT ID FROM SDOrder WHERE Explanation LIKE '#*') OR 'a'='b", "SALA", "PALA"},
    {"*') OR (SELECT count(*) FROM SDOrder WHERE Number=#)>0 OR (GRArticle.Name LIKE '*",
     "7002",
     "7009"},
    {"1) OR EXISTS(SELECT ID FROM SYUser WHERE PasswordHash LIKE '#*'", "$arg", "$xxx"},
    {"1)) OR EXISTS(SELECT 1 FROM GRPriceListRel WHERE Price=#) OR (1 IN (1", "7.77", "7.79"},
    {"501 OR ID=#", "502", "999"},
    {"1101 OR EXISTS(SELECT 1 FROM GRCompany WHERE ID=#)", "2", "9"},
    {"(CASE WHEN EXISTS(SELECT 1 FROM GRCompContPerson WHERE ID=#) THEN ID ELSE -ID END)",
     "2",
     "9"},
    {"GRArticle.Code, (SELECT max(Price) FROM GRPriceListRel WHERE IDGRPriceList=#)", "2", "9"},
    {"x' UNION SELECT * FROM SYUser WHERE ID=# --", "2", "9"},
    {"'; WAITFOR DELAY '0:0:#' --", "9", "0"},
    {"x%' AND 1=(SELECT 1/count(*) FROM SDOrder WHERE Number=#) --", "7009", "7002"},
    {"#", "502", "999"},
    {"#", "2101", "2999"},
    {"#", "SA-1", "XX-9"},
};

TEST_F(Ways, NoTextBringsOutWhatBelongsToOthers) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    for (const Way& way : kWays) {
        for (const auto& question : kQuestions) {
            if (way.shows_numbers && question.text == std::string("#")) continue;
            const auto ask = [&](const char* guess) {
                return Answer(mari, way, base::Replaced(question.text, "#", guess));
            };
            SCOPED_TRACE(std::string(way.label) + ": " + question.text);
            const std::string right = ask(question.right);
            EXPECT_EQ(right, ask(question.wrong));
            for (const char* secret :
                 {"Salajane", "SALADUS", "7,77", "99,00", "argon2", "Server error"}) {
                EXPECT_THAT(right, Not(HasSubstr(secret)));
            }
        }
    }
    EXPECT_EQ(company().Run("SELECT count(*) FROM SDOrder"), "3\n");
}

TEST_F(HostileInput, ForgedHeaderFieldsAndPrices) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "2"}, {"Price_1101", "1,00"}});
    EXPECT_THAT(mari.page(), HasSubstr("total=2,00]"));
    for (const char* field : {"IDGRCompany",
                              "idgrcompany",
                              " IDGRCompany ",
                              "GRCompany.ID",
                              "SDOrder.IDGRCompany",
                              "Number",
                              "STATE",
                              "IDGRPriceList",
                              "Amount",
                              "AmountWTax",
                              "TaxAmount",
                              "NeedsReview",
                              "IDGRCompContPerson",
                              "ID",
                              "DocKey",
                              "X"}) {
        mari.Post("Kinnitus&event=LisaTellimus",
                  {{"ZEB_But_Vormista", "1"},
                   {"sdorder." + std::string(field), "2"},
                   {"SDOrder.Explanation", "a"},
                   {"SDOrder." + std::string(field), "2"}});
        EXPECT_THAT(mari.page(), HasSubstr("(Probleem tellimuse salvestamisel!) sum=2,00"))
            << field;
    }
    EXPECT_EQ(company().Run("SELECT count(*) FROM SDOrder"), "3\n");
    // Fields of a row that the template does not offer are nobody's to set, and neither are sums.
    mari.Post("Kaubainfo&event=Tellimus",
              {{"Change_Quant", "1"},
               {"EF_Amount_1", "0"},
               {"EF_Status_1", "4"},
               {"EF_TaxPercent_1", "0"},
               {"EF_IDGRArticle_1", "105"},
               {"Row_1", "2"},
               {"Amount_1", "0"}});
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1102", "10"}, {"ID_1104", "1"}});
    mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}});
    EXPECT_EQ(company().Run("SELECT IDGRCompany, State, Amount, NeedsReview FROM SDOrder WHERE "
                            "Number = 7004"),
              "1|0|5.3|1\n");
    EXPECT_EQ(company().Run("SELECT IDGRArticle, Status, TaxPercent, ReviewPrice FROM SDOrderRow "
                            "WHERE IDSDOrder > 503 ORDER BY RowNo"),
              "101|0|24.0|8.5\n102|0|24.0|NULL\n104|0|24.0|0\n");
    EXPECT_EQ(company().Run("SELECT Number, CompanyName, ArticleCode, Price, ReviewPrice, Missing "
                            "FROM SDOrderReview ORDER BY RowNo"),
              "7004|Oma Äri OÜ|KR-1|1|8.5|15.0\n7004|Oma Äri OÜ|HI-1|0|0|0.0\n");
}

TEST_F(HostileInput, LargeForms) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    std::string body = "ID_1101=1";
    for (int i = 0; i < 5000; ++i) body += "&ID_9" + std::to_string(i) + "=1";
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(mari.Ask("/?page=Kaubainfo&event=Lisamine", "POST", body).status, 303);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(5));
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=1 "));

    for (int i = 0; i < 30000; ++i) body += "&a=1";
    EXPECT_EQ(mari.Ask("/?page=Kaubainfo&event=Lisamine", "POST", body).status, 413);
    EXPECT_EQ(mari.Ask("/?page=Kaubainfo", "POST", std::string(2 << 20, 'x')).status, 413);
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("[basket rows=1 "));
}

}  // namespace
}  // namespace zebtell
