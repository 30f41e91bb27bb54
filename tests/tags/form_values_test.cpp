#include "tags/form_values.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tags/price_query.h"
#include "tests/tags/session.h"

namespace zebtell::tags {
namespace {

web::Request Posted(std::vector<web::Field> fields) {
    web::Request request;
    request.Form = web::FieldList(std::move(fields));
    return request;
}

TEST(Queries, BelongToTheirPage) {
    Session session;
    EXPECT_FALSE(QueryExists(session.state, "List", "Kaubainfo"));
    data::clsQuery& query = GetQuery(session.state, "List", "Kaubainfo");
    EXPECT_EQ(query.Query, "List");
    EXPECT_EQ(query.ZEBApp, session.application);
    EXPECT_EQ(query.RecNo, 1);
    query.RecNo = 5;
    EXPECT_EQ(GetQuery(session.state, "LIST", "kaubainfo").RecNo, 5);
    EXPECT_FALSE(QueryExists(session.state, "List", "KInfo"));
    EXPECT_EQ(GetQuery(session.state, "List", "KInfo").RecNo, 1);
    EXPECT_TRUE(QueryExists(session.state, "list", "KINFO"));
}

TEST(Queries, OfAPageBeforeTheLogOnWorkAfterIt) {
    Session session;
    auto application = std::move(session.state.logon.Application);
    EXPECT_EQ(GetQuery(session.state, "List", "Logon").ZEBApp, nullptr);
    session.state.logon.Application = std::move(application);
    EXPECT_EQ(GetQuery(session.state, "List", "Logon").ZEBApp, session.application);
}

TEST(SaveFormValues, KeepsWhatIsMarked) {
    Session session;
    EXPECT_TRUE(SaveFormValues(session.state, Posted({{"Other", "x"}, {"save", "y"}})));
    EXPECT_FALSE(session.state.templates.SavedValues);

    EXPECT_TRUE(SaveFormValues(session.state,
                               Posted({{" save_a ", " \u00A0 one\u00A0"}, {"SAVE_b", "two"}})));
    EXPECT_TRUE(SaveFormValues(session.state, Posted({{"save_B", "three"}})));
    const auto& saved = session.state.templates.SavedValues;
    ASSERT_TRUE(saved);
    EXPECT_EQ(saved->size(), 2U);
    EXPECT_EQ(saved->find("SAVE_A")->second, "one");
    EXPECT_EQ(saved->find("save_b")->second, "three");

    std::vector<web::Field> many = {{"save_long", std::string(5000, 'x')}};
    for (int i = 0; i < 1000; ++i) many.push_back({"save_" + std::to_string(i), "x"});
    SaveFormValues(session.state, Posted(many));
    SaveFormValues(session.state, Posted({{"save_a", "four"}}));
    EXPECT_EQ(saved->size(), 200U);
    EXPECT_EQ(saved->find("save_a")->second, "four");
}

TEST(ParseQuantity, Rows) {
    const struct {
        const char* label;
        const char* text;
        int decimals;
        const char* expected;
    } rows[] = {
        {"whole", "12", 0, "12"},
        {"comma", "1,5", 1, "1.5"},
        {"point", "1.5", 1, "1.5"},
        {"blank between thousands", " 1 000,25\u00A0", 2, "1000.25"},
        {"no-break space between thousands", "1\u00A0000", 0, "1000"},
        {"half to even", "2,5", 0, "2"},
        {"half to even on decimal digits", "2.675", 2, "2.68"},
        {"negative", "-5", 0, "-5"},
        {"exponent", "1e3", 0, "1000"},
        {"more decimals than there are", "0.1234567890123456", 30, "0.123456789012346"},
        {"fewer than none", "15", -1, "15"},
        {"too large", "1e999", 0, "no"},
        {"empty", "", 0, "no"},
        {"blank", " \u00A0 ", 0, "no"},
        {"letters", "ten", 0, "no"},
        {"number and letters", "10kg", 0, "no"},
        {"two marks", "1.000,5", 1, "no"},
        {"not a number", "nan", 0, "no"},
        {"infinity", "inf", 0, "no"},
        {"hexadecimal", "0x10", 0, "no"},
    };
    Session session;
    for (const auto& row : rows) {
        session.state.basket_form.QuantityDecimals = static_cast<std::int16_t>(row.decimals);
        double result = 77;
        const bool parsed = ParseQuantity(session.state, row.text, result);
        EXPECT_EQ(parsed ? base::Value(result).ToPlainText() : "no", row.expected) << row.label;
        if (!parsed) {
            EXPECT_EQ(result, 77) << row.label;
        }
    }
}

TEST(FormNames, RowFieldsAndMarkers) {
    const auto request =
        Posted({{"Code_f1", " A\u00A0"}, {"Code_f-2", "B"}, {"ID_UNIQUE", " "}, {"x_unique", "1"}});
    EXPECT_EQ(ReadRowField(request, "Code", 1), "A");
    EXPECT_EQ(ReadRowField(request, "code", -2), "B");
    EXPECT_EQ(ReadRowField(request, "Code", 3), "");
    EXPECT_FALSE(IsUniqueField(request, "ID"));
    EXPECT_FALSE(IsUniqueField(request, "Code"));
    EXPECT_TRUE(IsUniqueField(request, "X"));
}

TEST(BuildPriceQuery, Placeholders) {
    const struct {
        const char* text;
        const char* expected;
    } rows[] = {
        {"gc.id=#P and list=#H in (#A) key #F", "gc.id=1 and list=3 in (8,9) key 2"},
        {"#p#h#a#f", "138,92"},
        {"##P #x# #", "#1 #x# #"},
        {"", ""},
    };
    for (const auto& row : rows)
        EXPECT_EQ(BuildPriceQuery(row.text, 1, 2, 3, "8,9"), row.expected) << row.text;
    EXPECT_EQ(BuildPriceQuery("in (#A)", 1, 2, 3, "#P"), "in (#P)");
}

}  // namespace
}  // namespace zebtell::tags
