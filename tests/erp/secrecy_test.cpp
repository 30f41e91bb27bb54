#include <gtest/gtest.h>

#include <functional>

#include "base/runtime_error.h"
#include "base/text.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

// What an attacker can see of an answer: the rows, or the words of the error.
std::string Outcome(const std::function<std::shared_ptr<data::RecordList>()>& ask) {
    try {
        const auto list = ask();
        std::string rows = std::to_string(list->Count()) + " rows:";
        for (std::int64_t i = 1; i <= list->Count(); ++i) {
            rows += " " + Text(*list->Item(i), "ID");
        }
        return rows;
    } catch (const base::RuntimeError& error) {
        return error.what();
    }
}

// An error may hold what was asked.
std::string Masked(const std::string& outcome, std::string_view asked) {
    const bool is_error = outcome.find(" rows:") == std::string::npos;
    return (is_error ? base::Replaced(outcome, asked, "?") : outcome) + "; ";
}

// mari is of company 1. Order 13, company 3 and its person and user are somebody else's.
class SecrecyTest : public PortalTest {
  protected:
    void SetUp() override { portal_ = LogOn(); }

    std::string Query(const std::string& sql) {
        return Outcome([&] { return portal_->OpenQuery(sql, 0, 0); });
    }
    std::string List(const std::string& table,
                     const data::Filter& filter,
                     const std::string& order = {}) {
        return Outcome([&] { return portal_->OpenList(table, filter, order); });
    }

    std::unique_ptr<data::DataApplication> portal_;
};

// The same answer for what is somebody else's and for what there is not, whichever way is gone.
TEST_P(SecrecyTest, AForeignRecordIsLikeNone) {
    const auto order = portal_->OpenTable("SDOrder", "ID=11")->First();
    const auto answer = [&](const std::string& table, const std::string& id) {
        const std::int64_t number = std::stoll(id);
        const auto is_there = [](bool there) { return there ? "there" : "none"; };
        std::string all;
        for (const std::string& outcome :
             {List(table, "ID=" + data::Filter(data::Typed{id})),
              List(table, "{ID in (select ID from " + table + " where ID=" + id + ")}"),
              Query("select * from " + table + " where ID=" + id),
              Query("select a.ID from GRTax a left join " + table + " b on b.ID=" + id +
                    " where b.ID is not null")}) {
            all += Masked(outcome, id);
        }
        all += is_there(portal_->Load(table, number) != nullptr);
        all += "; " + std::to_string(ErrorOf([&] { portal_->OpenTable(table)->Open(number); }));
        all +=
            "; " + std::to_string(ErrorOf([&] { portal_->OpenTable(table, "ID=" + id)->First(); }));
        if (table == "GRCompContPerson") {
            all += "; " + std::to_string(ErrorOf([&] { order->SetField("ID" + table, id); }));
        }
        return all;
    };
    const struct {
        const char* table;
        const char* own;
        const char* foreign;
    } rows[] = {
        {"SDOrder", "12", "13"},
        {"SDOrderRow", "1", "5"},
        {"GDTax", "1", "3"},
        {"GDocument", "12", "13"},
        {"GRCompany", "2", "3"},
        {"GRCompContPerson", "1", "2"},
        {"SYUser", "1", "2"},
        {"GRPriceList", "2", "1"},
        {"GRPriceListRel", "101", "201"},
        {"SQPriceList5", "101", "201"},
        {"GRPriceCatRel", "1", "2"},
        {"GRCompanyPriceCat", "1", "2"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(answer(row.table, row.foreign), answer(row.table, "99999")) << row.table;
        EXPECT_NE(answer(row.table, row.own), answer(row.table, "99999")) << row.table;
    }
}

// Questions about what the reader may not see: yes and no sound alike.
TEST_P(SecrecyTest, BlindQuestionsAreAnsweredAlike) {
    const struct {
        const char* question;  // "@" is the guess
        const char* right;
        const char* wrong;
    } rows[] = {
        {"exists (select 1 from SDOrder where Number=@)", "503", "599"},
        {"(select count(*) from SDOrder where IDGRCompany=@)>0", "3", "9"},
        {"(select count(*) from SDOrderRow where IDGRArticle=@)>0", "3", "5"},
        {"(select max(Amount) from SDOrder where ID>@)=6", "12", "13"},
        {"exists (select 1 from GRCompany where Name like '@%')", "V", "X"},
        {"exists (select 1 from GRCompContPerson where Name like '%@%')", "un", "xx"},
        {"exists (select 1 from SYUser where Name like '@%')", "W", "X"},
        {"exists (select 1 from SYUser where PasswordHash like '@%')", "$argon", "$x"},
        {"exists (select 1 from SYUser u where len(u.PasswordHash)>@)", "9", "999"},
        {"exists (select PasswordHash from SYUser where ID=@)", "1", "9"},
        {"exists (select 1 from GDocument where DocKey='@')", "k13", "x"},
        {"exists (select 1 from GRPriceListRel where IDGRPriceList=1 and Price=@)", "90", "91"},
        {"exists (select 1 from SQPriceList5 where IDGRPriceList=@)", "1", "9"},
        {"exists (select 1 from SDOrderRow r inner join SDOrder o on o.ID=@ and o.Number=503)",
         "13",
         "99"},
        {"1/(select count(*) from SDOrder where Number=@)=1", "503", "599"},
        {"exists (select 1 from SDOrder where case when Number=503 then 1/@ else 1 end=1)",
         "0",
         "1"},
        {"exists (select 1 from SDOrder where SDOrderRow.IDGRArticle=@)", "3", "5"},
        {"GRTax.GRArticle.SDOrderRow.SDOrder.Number=@", "503", "599"},
        {"exists (select 1 from SDOrderReview where Number=@)", "501", "599"},
    };
    for (const auto& row : rows) {
        const auto ask = [&](const char* guess) {
            const std::string condition = base::Replaced(row.question, "@", guess);
            return Masked(Query("select ID from GRTax where " + condition), guess) +
                   Masked(Query("select ID from GRTax order by case when " + condition +
                                " then ID else -ID end"),
                          guess) +
                   Masked(List("GRTax", "{" + base::Replaced(condition, "%", "*") + "}"), guess) +
                   Masked(List("GRTax", "", condition), guess);
        };
        EXPECT_EQ(ask(row.right), ask(row.wrong)) << row.question;
    }
    // The same questions about what is his own are answered, so the silence above means something.
    EXPECT_NE(Query("select ID from GRTax where exists (select 1 from SDOrder where Number=501)"),
              Query("select ID from GRTax where exists (select 1 from SDOrder where Number=599)"));
}

TEST_P(SecrecyTest, OrdersByOtherPeoplesValuesSayNothing) {
    for (const char* order : {"PasswordHash",
                              "IDPartner.Name",
                              "(select max(ID) from SDOrder)",
                              "case when 1=1 then ID end",
                              "ID; drop table SDOrder",
                              "ID desc -- x",
                              "rowid"}) {
        EXPECT_EQ(List("SYUser", "", order).find("rows:"), std::string::npos) << order;
        EXPECT_EQ(Query(std::string("select * from SYUser order by ") + order).find("rows:"),
                  std::string::npos)
            << order;
    }
    EXPECT_EQ(List("SYUser", "", "Partner.Parent.Name desc"), "1 rows: 1");
}

TEST_P(SecrecyTest, AnythingThatIsTypedIsSearchedFor) {
    const std::string texts[] = {"O'Ring",
                                 "''",
                                 "5' or '1'='1",
                                 "{x}",
                                 "100%_[a]\\",
                                 "a;--/**/\"b\"",
                                 "<b>&amp;",
                                 "\xC3\xB5\xE2\x80\xA8\xC5\xBE",
                                 "#1/1/2026#"};
    for (const std::string& text : texts) {
        company_->Run("update GRArticle set Name = 'x " + base::Replaced(text, "'", "''") +
                      " y' where ID = 7");
        const data::Filter found =
            "{GRArticle.Name like '" + data::Filter(data::Typed{"*" + text + "*"}) + "'}";
        EXPECT_EQ(List("GRPriceListRel", found), "1 rows: 107") << text;
        const data::Filter equal = "GRArticle.Name = '" + data::Filter(data::Typed{text}) + "'";
        EXPECT_EQ(List("GRPriceListRel", equal), "0 rows:") << text;
    }
}

INSTANTIATE_TEST_SUITE_P(Databases,
                         SecrecyTest,
                         testing::ValuesIn(DatabaseKinds()),
                         [](const auto& test) { return test.param.name; });

}  // namespace
}  // namespace zebtell::erp
