#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/text.h"
#include "erp/translator.h"
#include "tests/erp/sql_database.h"

namespace zebtell::erp {
namespace {

using testing::HasSubstr;
using testing::Not;

// What reaches the page: rows, or what the error says.
template <class Call>
std::string Outcome(Call call) {
    try {
        return Database().Run(call());
    } catch (const base::RuntimeError& error) {
        return std::string("error: ") + error.what();
    }
}

void ExpectNothingForeign(const std::string& outcome) {
    for (const char* mark : {"foreign", "777", "99.99", "98.5", "secret", "key-", "argon"}) {
        EXPECT_THAT(outcome, Not(HasSubstr(mark)));
    }
}

const char* const kSearch =
    "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner "
    "join GRArticle on P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '@' OR "
    "GRArticle.code LIKE '@') AND (IDGRPriceList=20))}";
const char* const kSearchColumn =
    "{GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
    "P5.IDGRArticle=GRArticle.ID where (GRArticle.@ LIKE '*') AND (IDGRPriceList=20))}";
const char* const kOwnSearch = "(GRArticle.code like '@' or GRArticle.name like '@')";
const char* const kCategory =
    "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select ID from SQCatPriceList5 where "
    "(IDGRArticleCat IN (@)) AND (IDGRPriceList=20))}";
const char* const kList =
    "{GRPriceListRel.ID IN (select ID from SQPriceList5 where (IDGRPriceList=@))}";

struct FilterRow {
    const char* filter;
    const char* typed;  // in the place of "@"
    const char* outcome;
};

const FilterRow kFilters[] = {
    // Texts that people search for
    {kSearch, "*' or 1=1 or '*", "1|1.15;3|12"},
    {kSearch, "x'))} union select ID, PasswordHash from SYUser --", "error"},
    {kSearch, "x'; drop table SDOrder; --", "error"},
    {kSearch, "x' /* ", "error"},
    {kSearch, "'", ""},
    {kSearch, "''", ""},
    {kSearch,
     "x') or P5.ID in (select ID from GRPriceListRel where Price>90) or (Name like 'x",
     ""},
    {kSearch,
     "x' or exists (select 1 from SYUser where PasswordHash like 'foreign*') or 'a'='",
     "error"},
    {kSearch, "\\' or 1=1", "error"},
    {kSearch, "%", ""},
    {kOwnSearch, "x' or IDGRPriceList=30 or 'a'='a", "1|1.15;2|0;3|12"},
    {kOwnSearch, "x') or ID in (select ID from GRCompany where Name like '*')", "error"},
    {kOwnSearch, "x' or load_extension('x') or '", "error"},
    // Categories, price lists, column names
    {kCategory, "1) or (1=1", "1|1.15;3|12"},
    {kCategory, "1)) or 1=1 or (ID in (7", "1|1.15;3|12"},
    {kCategory, "select IDGRArticleCat from GRArticleCatRel", "1|1.15;3|12"},
    {kCategory, "1 union select 2", "error"},
    {kCategory, "9999999999999999999999", ""},
    {kCategory, "1,", "error"},
    {kCategory, ":partner", "error"},
    {kCategory, "@x", "error"},
    {kCategory, "?", "error"},
    {kList, "30", ""},
    {kList, "20 or 1=1", "1|1.15;2|0;3|12"},
    {kList, "20)) or ((1=1", "1|1.15;2|0;3|12"},
    {kSearchColumn, "Name LIKE '*') or (GRArticle.Code", "1|1.15;2|0;3|12"},
    {kSearchColumn, "GRTax.Name", "1|1.15;2|0;3|12"},
    {kSearchColumn, "\"Name\"\" from SYUser\"", "error"},
    {kSearchColumn, "rowid", "error"},
    {"ID=@", "7", ""},
    {"ID=@", "7 or ID=6", ""},
    {"{@}", "1=1} or {1=1", "error"},
    {"{@}", "1=1", "1|1.15;2|0;3|12"},
    {"@", "{1=1", "error"},
    {"@", "case when exists (select 1 from SYUser where ID=2) then 1 else 0 end = 1", ""},
    {"@", "(select PasswordHash from SYUser) like 's*'", "error"},
    {"@", "(select count(*) from sqlite_master) > 0", "error"},
    {"@", "GRPriceList.SYUser.Name like '*'", "error"},
};

TEST(HostileTest, FiltersGiveOwnRowsOrFail) {
    const std::vector<std::string> columns = {"Price"};
    for (const FilterRow& row : kFilters) {
        const std::string filter = base::Replaced(row.filter, "@", row.typed);
        SCOPED_TRACE(filter);
        const std::string outcome = Outcome([&] {
            return Database().translator().ListKeys(
                FirstCustomer(), "GRPriceListRel", filter, "", columns);
        });
        ExpectNothingForeign(outcome);
        EXPECT_EQ(outcome.starts_with("error") ? "error" : outcome, row.outcome);
    }
}

data::Filter WithTyped(std::string_view filter, std::string_view typed) {
    data::Filter whole;
    for (const std::string_view piece : base::Split(filter, '@')) {
        whole += (whole.empty() ? "" : data::Filter(data::Typed{typed})) + piece;
    }
    return whole;
}

// The same texts as people type them: in quotes a text that no article holds, elsewhere an error.
TEST(HostileTest, TypedTextIsAValueAndNothingElse) {
    const auto outcome_of = [](const Reader& reader, const data::Filter& filter) {
        return Outcome([&] {
            return Database().translator().ListKeys(reader, "GRPriceListRel", filter, "", {});
        });
    };
    for (const FilterRow& row : kFilters) {
        if (*row.filter == '@') continue;
        SCOPED_TRACE(base::Replaced(row.filter, "@", row.typed));
        const std::string outcome = outcome_of(FirstCustomer(), WithTyped(row.filter, row.typed));
        const bool in_quotes = row.filter == kSearch || row.filter == kOwnSearch;
        const bool number =
            std::string_view(row.typed).find_first_not_of("0123456789") == std::string_view::npos;
        EXPECT_EQ(outcome.starts_with("error") ? "error" : outcome,
                  in_quotes || number ? "" : "error");
    }
    const struct {
        const char* filter;
        const char* typed;
        const char* keys;  // a guest's
    } rows[] = {
        {kOwnSearch, "It's*", "5"},
        {kOwnSearch, "It''s*", ""},
        {kOwnSearch, "*'*", "5"},
        {kOwnSearch, "X_1", "5"},
        {"GRArticle.Code in ('@','@')", "X_1", "5"},
        {"ID in (@)", "4, 5,6", "4;5"},
        {"ID in (@)", "4)", "error"},
        {"ID in (@)", "'4'", "error"},
        {"ID in (@)", "ID", "error"},
        {"ID in (@)", "-4", "error"},
        {"ID=1@", "2 or 1=1", "error"},
        {"ID=1@", "2", "error"},  // no part of what the filter says itself
        {"GRArticle.N@='x'", "ame", "error"},
        {"GRArticle.[N@]='x'", "ame", "error"},
        {"GRArticle.Name like 'x'@", "'", "error"},
        {"{ID>0 and '@'='@'}", "x' or 'a'='", "4;5"},
    };
    for (const auto& row : rows) {
        const std::string outcome = outcome_of(GuestReader(), WithTyped(row.filter, row.typed));
        EXPECT_EQ(outcome.starts_with("error") ? "error" : outcome, row.keys)
            << row.filter << " with " << row.typed;
    }
}

struct StatementRow {
    const char* text;
    const char* user;
    const char* guest;
};

const char* const kNone = "error";

const StatementRow kStatements[] = {
    {"SELECT * FROM SDOrder o WHERE IDGRCompany=2 or 1=1 ORDER BY ID desc", nullptr, nullptr},
    {"select ID from SDOrder", "100;101", "101"},
    {"select ID from SDOrderRow where IDSDOrder=200 or 1=1", "1;2", ""},
    {"select ID from SDInvoice", "110", ""},
    {"select ID from SDInvoiceRow", "1", ""},
    {"select ID from SDConsignmD", "120", ""},
    {"select ID from DDStoreDRow", "1", ""},
    {"select ID from GDTax", "1", ""},
    {"select ID from GDocument order by ID", "100;101;110;120", "101"},
    {"select ID from GDocRel", "1", kNone},
    {"select DocKey from GDocument", kNone, kNone},
    {"select d.dockey from (select * from GDocument) d", kNone, kNone},
    {"select ID from GRCompany order by ID", "1;3", ""},
    {"select Name from GRCompContPerson", "Jaan", ""},
    {"select Name from EREmployee", "Mari", ""},
    {"select Name from SYUser", "first", ""},
    {"select PasswordHash from SYUser", kNone, kNone},
    {"select ID from SYUser order by PasswordHash", kNone, kNone},
    {"select ID from GRTax order by case when exists (select 1 from SDOrder) then 1 end",
     kNone,
     kNone},
    {"select ID from GRTax order by (select max(ID) from SDOrder)", kNone, kNone},
    {"select ID from GRTax order by ID+1", kNone, kNone},
    {"select * from SDOrderReview", kNone, kNone},
    {"select count(*) from SYUser group by Name having max(PasswordHash) like 's%'", kNone, kNone},
    {"select ID from GRPriceList", "10;20", "11"},
    {"select ID from GRPriceListRel", "1;2;3", "4;5"},
    {"select ID from SQPriceList5 where IDGRPriceList=20", "1;2;3", ""},
    {"select max(Price) from SQCatPriceList5", "12", "2"},
    {"select PriceCut from GRPriceCatRel", "-7.5", ""},
    {"select Name from GRCompanyPriceCat", "Good", ""},
    {"select o.ID from SDOrderRow r inner join SDOrder o on 1=1 and r.ID=3", "", ""},
    {"select o.ID from GRTax t left join SDOrder o on o.ID=200 or t.ID=0 where t.ID=1", "", ""},
    {"select o.ID from GRTax t, SDOrder o where t.ID=1 and o.IDGRCompany<>1", "", ""},
    {"select (select max(Amount) from SDOrder where ID>=200) from GRTax where ID=1", "", ""},
    {"select ID from GRTax where exists (select 1 from SDOrder where ID=200) or (select count(*) "
     "from SDInvoice i inner join SDOrder o on o.ID=o.ID where o.ID=200)>0",
     "",
     ""},
    {"select SDOrder.ID from GRCompany as SDOrder where ID=2", "", ""},
    {"select [GRCompany].Name from [SDOrder] [GRCompany]", kNone, kNone},
    {"select Name from sqlite_master", kNone, kNone},
    {"select name from main.sqlite_master", kNone, kNone},
    {"select name from sys.objects", kNone, kNone},
    {"select name from pragma_table_info('SYUser')", kNone, kNone},
    {"select value from json_each('[1]')", kNone, kNone},
    {"select load_extension('x') from GRTax", kNone, kNone},
    {"select randomblob(1000000000) from GRTax", kNone, kNone},
    {"select ID from GRTax union select ID from SYUser", kNone, kNone},
    {"select ID from GRTax; delete from SDOrder", kNone, kNone},
    {"select ID into x from GRTax", kNone, kNone},
    {"with x as (select 1) select * from x", kNone, kNone},
    {"delete from SDOrder", kNone, kNone},
    {"pragma query_only=0", kNone, kNone},
    {"select ID as [x\"; drop table SDOrder; --] from GRTax where ID=1", "1", "1"},
    {"select [x]] y] from GRTax", kNone, kNone},
    {"select @@version from GRTax", kNone, kNone},
    {"select ID from GRTax where Name = N'\xC5' or ID=1", kNone, kNone},
    {"select ID from GRTax for xml auto", kNone, kNone},
    {"select ID from GRTax with (tablock)", kNone, kNone},
    {"", kNone, kNone},
};

TEST(HostileTest, StatementsGiveOwnRowsOrFail) {
    for (const StatementRow& row : kStatements) {
        SCOPED_TRACE(row.text);
        for (const Reader& reader : {FirstCustomer(), GuestReader()}) {
            const std::string outcome =
                Outcome([&] { return Database().translator().Select(reader, row.text); });
            ExpectNothingForeign(outcome);
            const char* expected = reader.role == Role::kUser ? row.user : row.guest;
            if (expected) {
                EXPECT_EQ(outcome.starts_with("error") ? "error" : outcome, expected);
            }
        }
    }
}

TEST(HostileTest, ErrorsNeverCarryMarkup) {
    const char* const kTexts[] = {"Name = <script>alert(1)</script>",
                                  "[<b onclick='x'>] = 1",
                                  "'<script>",
                                  "\"a<b>c&d\".e = 1",
                                  "dateadd([<i>], 1, 2) = 1",
                                  "cast(1 as [<i>]) = 1"};
    for (const char* text : kTexts) {
        const std::string outcome = Outcome([&] {
            return Database().translator().ListKeys(FirstCustomer(), "GRTax", text, "", {});
        });
        EXPECT_TRUE(outcome.starts_with("error: ")) << text;
        EXPECT_EQ(outcome.find_first_of("<>'"), std::string::npos) << outcome;
    }
    EXPECT_EQ(ShownOrError([] {
                  return Database().translator().Select(FirstCustomer(), "select 1 from [<b>]");
              }),
              "no such table");
}

}  // namespace
}  // namespace zebtell::erp
