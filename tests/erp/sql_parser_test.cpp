#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "erp/sql/parser.h"
#include "tests/erp/sql_database.h"

namespace zebtell::erp::sql {
namespace {

std::string Repeated(std::string_view text, int times) {
    std::string result;
    for (int i = 0; i < times; ++i) {
        result += text;
    }
    return result;
}

bool Parses(const std::string& condition) {
    try {
        return Parser(condition, Style::kFilter).ParseCondition() != nullptr;
    } catch (const base::RuntimeError& error) {
        EXPECT_EQ(error.number(), base::errors::kStatementFailed);
        return false;
    }
}

TEST(ParserTest, Conditions) {
    const struct {
        const char* text;
        bool parses;
    } rows[] = {
        {"a=1 and not b<>.5e-3 or (c!=N'x' and d>=#1/2/2026#)", true},
        {"a like '*' and b not like 'x' and c not in (-1, 2) and d is not null", true},
        {"a not between 1+1 and 2*2 and exists (select 1 from t)", true},
        {"[a b].\"c d\" = 'it''s'", true},
        {"a = case b when 1 then 2 else 3 end", true},
        {"a\t=\r\n1", true},
        {"a = 1 = 2", false},
        {"a not = 1", false},
        {"a = 12abc", false},
        {"a = 1.2.3", false},
        {"a = 1e", false},
        {"a = 1e999", false},
        {"a = 0x10", false},
        {"a = #2/30/2026#", false},
        {"a = #20/11/2026#", false},
        {"a = #1/2/2026 25:00#", false},
        {"a = ##", false},
        {"a = 'x", false},
        {"a = 'x\\'y'", false},
        {"[a = 1", false},
        {"a in (1,)", false},
        {"a in (1;2)", false},
        {"a like 'x' escape '!'", false},
        {"a = 1 -- x", false},
        {"a = 1 /* x */", false},
        {"a = @x", false},
        {"a = :partner", false},
        {"a = ?", false},
        {"a = $1", false},
        {"a = 1;", false},
        {"a = 1)", false},
        {"(a = 1", false},
        {"select", false},
        {"order = 1", false},
        {"a..b = 1", false},
        {"a.* = 1", false},
        {"count(*, 1) = 1", false},
        {"upper(distinct a) = 1", false},
        {"round(a) = 1", false},
        {"a = case end", false},
        {"a = cast(b as int(5))", false},
        {"a = cast(b as varchar(99999))", false},
        {"a = '\xC3'", false},
        {"a \xC2\xA0= 1", false},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(Parses(row.text), row.parses) << row.text;
    }
    EXPECT_FALSE(Parses(std::string("a = 'x\0y'", 10)));
    EXPECT_FALSE(Parses(std::string("a = 1\0", 6)));
}

// The tree is never deeper than the stack allows, whatever nests or repeats.
TEST(ParserTest, NestingAndLength) {
    const struct {
        const char* label;
        std::string text;
        bool parses;
    } rows[] = {
        {"99 parentheses", Repeated("(", 99) + "a=1" + Repeated(")", 99), true},
        {"100,000 parentheses", Repeated("(", 100000), false},
        {"100,000 times not", Repeated("not ", 100000) + "a=1", false},
        {"100,000 signs", "a = " + Repeated("- ", 100000) + "1", false},
        {"100,000 cases", "a = " + Repeated("case when ", 100000), false},
        {"100,000 functions", "a = " + Repeated("abs(", 100000), false},
        {"100,000 selects", "a in " + Repeated("(select b from (", 100000), false},
        {"5,000 times or", Repeated("a=1 or ", 5000) + "a=1", true},
        {"100,000 times and", Repeated("a=1 and ", 100000) + "a=1", false},
        {"400 terms", "a=1" + Repeated("+1", 400), true},
        {"100,000 terms", "a=1" + Repeated("*1", 100000), false},
        {"30,000 numbers", "a in (1" + Repeated(",-30000", 30000) + ")", true},
        {"30,000 texts", "a in ('1'" + Repeated(",'2'", 30000) + ")", false},
        {"a text of 1 MB", "a = '" + Repeated("x", 1 << 20) + "'", true},
        {"5 MB", "a = '" + Repeated("x", 5 << 20) + "'", false},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(Parses(row.text), row.parses) << row.label;
    }
}

enum class Fate { kRefused, kRan };

// What is printed is well formed, whatever it was printed of.
Fate Try(const std::string& statement) {
    BoundSql printed;
    try {
        printed = Database().translator().Select(FirstCustomer(), statement);
    } catch (const base::RuntimeError&) {
        return Fate::kRefused;
    }
    try {
        Database().Run(printed);
    } catch (const base::RuntimeError& error) {
        const std::string_view words = error.what();
        for (const char* malformed : {"syntax", "token", "incomplete", "no such", "ambiguous"}) {
            EXPECT_EQ(words.find(malformed), std::string_view::npos) << words << printed.text;
        }
    }
    return Fate::kRan;
}

TEST(ParserTest, CutAndChangedAtEveryByte) {
    const std::string text =
        "select distinct top 3 a.*, isnull(b.Name, 'x''y') as [n m], case when a.ID in (1,2) then "
        "#11/20/2026# else null end from GRArticle a with (nolock) left join (select ID, Name from "
        "GRTax) b on b.ID=a.IDGRTax where not (a.Name like '%\xC3\xB5%') and a.ID between -1 and "
        "2.5e3 group by a.ID having count(*)>1 order by 1 desc, a.Name";
    ASSERT_EQ(Try(text), Fate::kRan);
    int ran = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        ran += Try(text.substr(0, i)) == Fate::kRan ? 1 : 0;
        for (const char byte : {'\'', '"', '[', '#', '(', ')', ';', '-', ' ', '\0', '\xFF'}) {
            std::string changed = text;
            changed[i] = byte;
            ran += Try(changed) == Fate::kRan ? 1 : 0;
        }
    }
    EXPECT_GT(ran, 50);
    EXPECT_LT(ran, static_cast<int>(text.size()) * 3);
}

}  // namespace
}  // namespace zebtell::erp::sql
