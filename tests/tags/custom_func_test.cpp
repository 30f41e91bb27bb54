#include "tags/custom_func.h"

#include <gtest/gtest.h>

#include "tests/support/fake_data.h"

namespace zebtell::tags {
namespace {

using base::Currency;
using base::Value;

TEST(CleanFormValue, Rows) {
    const struct {
        const char* text;
        const char* expected;
    } rows[] = {
        {"", ""},
        {"  a  b ", "a  b"},
        {"\u00A0 12\u00A0000\u00A0", "12 000"},
        {"\u00A0", ""},
        {"\ta ", "\ta"},
        {"\u00E0\u00C2 ", "\u00E0\u00C2"},  // letters that share bytes with it
        {"\xA0 broken", "\xA0 broken"},
    };
    for (const auto& row : rows) EXPECT_EQ(CleanFormValue(row.text), row.expected) << row.text;
}

TEST(CleanPriceQueryText, Rows) {
    const struct {
        const char* text;
        const char* expected;
    } rows[] = {
        {"\r\n\tselect 1\u00A0 \r\n", "select 1"},
        {"a &LT; 1 and b &gt;= 2", "a < 1 and b >= 2"},
        {"a&nbsp;&amp; b", "a & b"},
        {"'&amp;lt;'", "'&lt;'"},
        {"&quot;", "&quot;"},
        {"", ""},
    };
    for (const auto& row : rows) EXPECT_EQ(CleanPriceQueryText(row.text), row.expected) << row.text;
}

class FormatFieldValueTest : public testing::Test {
  protected:
    std::string Formatted(std::string_view reference, std::string_view format = {}) {
        return FormatFieldValue(*record_, reference, format, base::RegionFor("et"));
    }

    std::shared_ptr<fake::Record> record_ = fake::MakeRecord({
        {"Name", "  Polt M8 "},
        {"Eight", "abcdefgh"},
        {"Seven", "abcdefg"},
        {"Umlauts", "\u00F5\u00E4\u00F6\u00FC\u0161\u017E\u00D5\u00C4"},
        {"Quotes", "5\" 'x'\r\nend "},
        {"Markup", "<b>&amp;</b>"},
        {"Tag", "<ZEB:WEBUser>x</ZEB:WEBUser>"},
        {"Blank", ""},
        {"Blanks", "   "},
        {"Null", Value::Null()},
        {"Empty", Value()},
        {"Price", Currency::FromText("1234.5")},
        {"Stock", 12},
        {"Zero", 0},
        {"Day", base::DateTime(46347.75)},
        {"NoDay", base::DateTime()},
        {"TimeOnly", base::DateTime(0.25)},
        {"Code", "AB-12"},
        {"GRArticle.Code", "K1"},
    });
};

struct FieldRow {
    const char* label;
    const char* reference;
    const char* format;
    const char* expected;
};

TEST_F(FormatFieldValueTest, Plain) {
    const FieldRow rows[] = {
        {"text is not trimmed", "Name", "", "  Polt M8 "},
        {"names ignore case", "NAME", "", "  Polt M8 "},
        {"blanks around a name", " Code ", "", "AB-12"},
        {"dotted path", "GRArticle.Code", "", "K1"},
        {"number in the region's way", "Price", "", "1234,5"},
        {"format argument", "Price", "0.00", "1234,50"},
        {"named format", "Price", "Fixed", "1234,50"},
        {"a modifier wins over the argument", "Price;0", "0.00", "1235"},
        {"date picture", "Day;dd.mm.yyyy", "", "21.11.2026"},
        {"nothing", "Blank", "", "&nbsp;"},
        {"empty value", "Empty", "", "&nbsp;"},
        {"null formatted", "Null", "0.00", "&nbsp;"},
        {"null formatted by a modifier", "Null;0.00", "", "&nbsp;"},
        {"null is no text", "Null", "", ""},
        {"unknown field", "Missing", "", ""},
        {"no reference", "", "", ""},
        {"markup", "Markup", "", "&lt;b&gt;&amp;&lt;/b&gt;"},
        {"a tag in the data", "Tag", "", "&lt;ZEB:WEBUser&gt;x&lt;/ZEB:WEBUser&gt;"},
        {"markup of a picture", "Stock;\"<\"0", "", "&lt;12"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(Formatted(row.reference, row.format), row.expected) << row.label;
}

TEST_F(FormatFieldValueTest, TextModifiers) {
    const FieldRow rows[] = {
        {"trimmed", "Name;zeb:", "", "Polt M8"},
        {"cut", "Eight;zeb:len=10", "", "abcdefg..."},
        {"what fits stays", "Seven;zeb:len=10", "", "abcdefg"},
        {"cut by characters", "Umlauts;ZEB:LEN=8", "", "\u00F5\u00E4\u00F6\u00FC\u0161..."},
        {"four is the shortest", "Eight;zeb:len=4", "", "a..."},
        {"three never cuts", "Eight;zeb:len=3", "", "abcdefgh"},
        {"more words behind the length", "Eight;zeb:len=7,quote,nospace", "", "abcd..."},
        {"blanks around the length", "Eight;zeb:len= 7 ", "", "abcd..."},
        {"length that is none", "Eight;zeb:len=x", "", "abcdefgh"},
        {"length that is too large", "Eight;zeb:len=99999", "", "abcdefgh"},
        {"negative length", "Eight;zeb:len=-5", "", "abcdefgh"},
        {"quotation marks", "Quotes;zeb:quote", "", "5&quot; &acute;x&acute; end"},
        {"quote, cut before", "Quotes;zeb:quote,len=5", "", "5&quot;..."},
        {"without quote", "Quotes;zeb:", "", "5\" 'x'\r\nend"},
        {"nothing", "Blanks;zeb:", "", "&nbsp;"},
        {"nospace", "Blanks;zeb:nospace", "", ""},
        {"nospace with text", "Markup;zeb:NoSpace", "", "&lt;b&gt;&amp;&lt;/b&gt;"},
        {"null", "Null;zeb:", "", ""},
        {"number", "Price;zeb:", "", "1234,5"},
        {"attribute", "Quotes;zeb:attr", "", "5&quot; &#39;x&#39;\r\nend"},
        {"attribute, escaped once", "Markup;zeb:ATTR", "", "&lt;b&gt;&amp;amp;&lt;/b&gt;"},
        {"attribute, a tag in it", "Tag;zeb:attr", "", "&lt;ZEB:WEBUser&gt;x&lt;/ZEB:WEBUser&gt;"},
        {"attribute, nothing", "Blanks;zeb:attr", "", ""},
        {"attribute, null", "Null;zeb:attr", "", ""},
        {"attribute wins over quote", "Quotes;zeb:quote,attr", "", "5&quot; &#39;x&#39;\r\nend"},
        {"attribute, cut before", "Quotes;zeb:attr,len=7", "", "5&quot; &#39;..."},
        {"attribute, number", "Price;zeb:attr", "", "1234,5"},
    };
    for (const auto& row : rows) EXPECT_EQ(Formatted(row.reference), row.expected) << row.label;
}

TEST_F(FormatFieldValueTest, Dates) {
    const FieldRow rows[] = {
        {"picture", "Day;dd.mm.yyyy;zebdate", "", "21.11.2026"},
        {"letters", "Day;yyyy-mm-dd;ZebDate", "", "2026-11-21"},
        {"no picture", "Day;zebdate", "", "21.11.2026 18:00:00"},
        {"no picture behind a mark", "Day;;zebdate", "", "21.11.2026 18:00:00"},
        {"zero date", "NoDay;zebdate", "", "&nbsp;"},
        {"a time without a day", "TimeOnly;hh:nn;zebdate", "", "&nbsp;"},
        {"empty value", "Empty;zebdate", "", "&nbsp;"},
        {"null", "Null;dd.mm.yyyy;zebdate", "", ""},
        {"no date", "Code;dd.mm.yyyy;zebdate", "", ""},
    };
    for (const auto& row : rows) EXPECT_EQ(Formatted(row.reference), row.expected) << row.label;
}

TEST_F(FormatFieldValueTest, Conditions) {
    const FieldRow rows[] = {
        {"equal", "?Code=ab-12;yes", "", "yes"},
        {"not equal", "?Code=x;yes", "", ""},
        {"differs", "?Code#x;yes", "", "yes"},
        {"differs not", "?Code#AB-12;yes", "", ""},
        {"trimmed value", "?Name=Polt M8;yes", "", "yes"},
        {"compare text is not trimmed", "?Code= AB-12;yes", "", ""},
        {"empty compare text", "?Blanks=;none", "", "none"},
        {"null is no text", "?Null=;none", "", ""},
        {"less", "?Stock<12,5;few", "", "few"},
        {"less not", "?Stock<12;few", "", ""},
        {"greater", "?Price>1234.4;much", "", "much"},
        {"greater not", "?Price>1234.5;much", "", ""},
        {"no number", "?Code>1;x", "", ""},
        {"compared with no number", "?Stock<few;x", "", ""},
        {"pattern", "?Code='a*-#2';yes", "", "yes"},
        {"pattern without its second mark", "?Code='[a-c]?*;yes", "", "yes"},
        {"pattern not", "?Code#'A*';yes", "", ""},
        {"another pattern", "?Code#'B*';yes", "", "yes"},
        {"wrong pattern", "?Code='[A';yes", "", ""},
        {"list", "?Code=(x,ab-12);yes", "", "yes"},
        {"not listed", "?Code=(x,y);yes", "", ""},
        {"listed, not wanted", "?Code#(x,AB-12);yes", "", ""},
        {"not listed, wanted", "?Code#(x,y);yes", "", "yes"},
        {"items are not trimmed", "?Code=(x, AB-12);yes", "", ""},
        {"empty list", "?Code#();yes", "", "yes"},
        {"output as it stands", "?Zero=0;<b>;</b>", "", "<b>;</b>"},
        {"empty output", "?Zero=0;", "", ""},
        {"no output", "?Zero=0", "", ""},
        {"no operator before the mark", "?Zero;a=b", "", ""},
        {"priority, not position", "?Stock<1=2;x", "", ""},
        {"unknown field", "?Missing#1;x", "", ""},
        {"operator in the output counts: greater", "?Stock=3;<b>x</b>", "", "<b>x</b>"},
        {"operator in the output counts: less", "?Stock=99;<b", "", "<b"},
        {"operator in the output counts: differs", "?Stock=3;#c0", "", "#c0"},
        {"operator in the output, no numbers", "?Code=3;<b>x</b>", "", ""},
        {"date in the region's way", "?Day=21.11.2026 18:00:00;today", "", "today"},
    };
    for (const auto& row : rows) EXPECT_EQ(Formatted(row.reference), row.expected) << row.label;
}

TEST_F(FormatFieldValueTest, Alternatives) {
    const FieldRow rows[] = {
        {"the first with text", "Blank|Null|Missing|Code|Name", "", "AB-12"},
        {"blanks around names", "Blank | Code", "", "AB-12"},
        {"all empty", "Blank|Null", "", ""},
        {"modifiers in parts", "NoDay;zebdate|Stock;0.0", "", "12,0"},
        {"format argument", "Null|Stock", "0.00", "12,00"},
        {"condition, then a field", "?Stock>99;much|Code", "", "AB-12"},
        {"condition that holds", "?Stock>9;much|Code", "", "much"},
        {"only a mark", "|", "", ""},
    };
    for (const auto& row : rows)
        EXPECT_EQ(Formatted(row.reference, row.format), row.expected) << row.label;
}

}  // namespace
}  // namespace zebtell::tags
