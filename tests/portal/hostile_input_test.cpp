#include <gmock/gmock.h>

#include <chrono>

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

TEST_F(HostileInput, TextsStayTexts) {
    const std::string texts[] = {"<script>alert(1)</script>",
                                 "\"'><b x=\"",
                                 "<ZEB:WEBUser>x</ZEB:WEBUser>",
                                 "</textarea><ZEB:SDOrder>Amount</ZEB:SDOrder>",
                                 "\xF0\x9F\x94\xA9 \xE2\x82\xAC",
                                 std::string("nul\0byte", 8),
                                 "&lt;b&gt;",
                                 "#P#H#A#F ?*[%_",
                                 "\xFF\xFE broken"};
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
    for (const std::string& text : texts) {
        mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", text}, {"save_x", text}});
        for (const char* page : {"Kaubainfo", "Koostamine", "Kinnitus"}) {
            mari.Post("Kaubainfo&event=Tellimus",
                      {{"Change_Quant", "1"},
                       {"Row_1", text},
                       {"Expl_1", text},
                       {"SDOrder.Explanation", text}});
            mari.Get(page);
            EXPECT_EQ(mari.status(), 200) << text;
            EXPECT_THAT(mari.page(), Not(HasSubstr("<script"))) << text;
            EXPECT_THAT(mari.page(), Not(HasSubstr("<b"))) << text;
            EXPECT_THAT(mari.page(), Not(HasSubstr("<ZEB:"))) << text;
            EXPECT_EQ(mari.page().find('\0'), std::string::npos) << text;
        }
    }
    mari.Post("Kinnitus&event=LisaTellimus",
              {{"ZEB_But_Vormista", "1"}, {"ZEB_Komment", "O'Ring \"\xF0\x9F\x94\xA9\" <b>&lt;"}});
    EXPECT_EQ(company().Run("SELECT Explanation FROM SDOrder WHERE Number = 7004"),
              "O'Ring \"\xF0\x9F\x94\xA9\" <b>&lt;\n");
    EXPECT_THAT(mari.page(), HasSubstr("comment=O'Ring \"\xF0\x9F\x94\xA9\" &lt;b&gt;&lt; sum="));
}

TEST_F(HostileInput, NoTextBringsOutWhatBelongsToOthers) {
    const char* const kTexts[] = {
        "'",
        "x' OR '1'='1",
        "x') OR 1=1 --",
        "x' UNION SELECT * FROM SYUser --",
        "'; DROP TABLE SDOrder",
        "x')) OR GRPriceListRel.IDGRPriceList=2 OR ((GRArticle.Code LIKE 'x",
        "*",
        "%",
        "SA-1",
        "x' OR EXISTS(SELECT ID FROM SDOrder WHERE Explanation LIKE 'SAL*') OR 'a'='b"};
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    const auto expect_nothing_foreign = [&](std::string_view where, std::string_view text) {
        EXPECT_EQ(mari.status(), 200) << where << text;
        for (const char* secret :
             {"Salajane", "SALADUS", "7,77", "99,00", "argon2", "Server error"}) {
            EXPECT_THAT(mari.page(), Not(HasSubstr(secret))) << where << text;
        }
    };
    for (const std::string text : kTexts) {
        mari.Post("Kaubainfo&event=Otsing", {{"ZEBInText", text}});
        expect_nothing_foreign("search ", text);
        mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", ""}, {"Combo_GRArticleCat", text}});
        expect_nothing_foreign("category ", text);
        mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", ""}, {"DataOrder", text}});
        expect_nothing_foreign("order ", text);
        mari.Post("Kaubainfo&event=Hinnakiri", {{"ZEBInText", ""}, {"DataOrder", ""}});
        mari.Get("KInfo&event=Show&ID=" + http::EncodeComponent("101 OR 1=1" + text));
        expect_nothing_foreign("article ", text);
        mari.Get("Tellimus&event=ID_" + http::EncodeComponent("502" + text));
        expect_nothing_foreign("order number ", text);
        mari.Get("Kinnitus&event=ID_" + http::EncodeComponent("502" + text));
        expect_nothing_foreign("order as basket ", text);
        mari.Post("Kaubainfo&event=Lisamine", {{"Code_f1", text}, {"Quantity_f1", "1"}});
        expect_nothing_foreign("code ", text);
    }
    EXPECT_EQ(company().Run("SELECT count(*) FROM SDOrder"), "3\n");
}

TEST_F(HostileInput, ForgedHeaderFieldsAndPrices) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "2"}, {"Price_1101", "1,00"}});
    EXPECT_THAT(mari.page(), HasSubstr("total=2,00]"));
    for (const char* field :
         {"IDGRCompany", "Number", "State", "Amount", "NeedsReview", "ID", "X"}) {
        mari.Post("Kinnitus&event=LisaTellimus",
                  {{"ZEB_But_Vormista", "1"}, {"SDOrder." + std::string(field), "2"}});
        EXPECT_THAT(mari.page(), HasSubstr("(Probleem tellimuse salvestamisel!) sum=2,00"))
            << field;
    }
    EXPECT_EQ(company().Run("SELECT count(*) FROM SDOrder"), "3\n");
    mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}});
    EXPECT_EQ(
        company().Run("SELECT IDGRCompany, Amount, NeedsReview FROM SDOrder WHERE Number = 7004"),
        "1|2|1\n");
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
