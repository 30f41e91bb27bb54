#include "base/text.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <unordered_map>

namespace zebtell::base {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr auto kNowhere = std::string_view::npos;

TEST(TextTest, CaseOfLettersBeyondAscii) {
    struct Row {
        const char* upper;
        const char* lower;
    };
    const Row rows[] = {
        {"KAUBAINFO", "kaubainfo"},
        {"ÕÄÖÜŠŽ", "õäöüšž"},
        {"ĀČĒĢĪĶĻŅŪ", "āčēģīķļņū"},
        {"ЖЁЯ", "жёя"},
        {"ΆΣΩ", "άσω"},
        {"ẀỲ", "ẁỳ"},
        {"ŸÞ", "ÿþ"},
        {"\xC4;\xFF", "\xC4;\xFF"},  // no UTF-8
    };
    for (const Row& row : rows) {
        EXPECT_EQ(Lower(row.upper), row.lower);
        EXPECT_EQ(Upper(row.lower), row.upper);
        EXPECT_TRUE(EqualNoCase(row.upper, row.lower)) << row.upper;
        EXPECT_EQ(NoCaseHash()(row.upper), NoCaseHash()(row.lower)) << row.upper;
    }
    EXPECT_EQ(LowerAscii("AÕz"), "aÕz");
    EXPECT_FALSE(EqualNoCase("×", "÷"));
    EXPECT_FALSE(EqualNoCase("[", "{"));
    EXPECT_FALSE(EqualNoCase("ß", "SS"));
    EXPECT_FALSE(EqualNoCase("K", "\u212A"));  // the sign for kelvin
    EXPECT_FALSE(EqualNoCase("\xC3", "\xE3"));
}

TEST(TextTest, FindsIgnoringCase) {
    EXPECT_EQ(FindNoCase("Tere ÕUN", "õun"), 5U);
    EXPECT_EQ(FindNoCase("aAbAAB", "aab", 1), 3U);
    EXPECT_EQ(FindNoCase("abc", "", 3), 3U);
    EXPECT_EQ(FindNoCase("abc", "", 4), kNowhere);
    EXPECT_EQ(FindNoCase("abc", "c", kNowhere), kNowhere);
    EXPECT_EQ(FindNoCase("ab", "abc"), kNowhere);
    EXPECT_TRUE(StartsWithNoCase("ZEB:WEBUser", "zeb:"));
    EXPECT_FALSE(StartsWithNoCase("ZEB", "zeb:"));
    EXPECT_TRUE(EndsWithNoCase("ÕLI.ROW", ".row"));
    EXPECT_FALSE(EndsWithNoCase("row", ".row"));
}

TEST(TextTest, ReplacesEveryPlaceOnce) {
    EXPECT_EQ(Replaced("aaa", "aa", "b"), "ba");
    EXPECT_EQ(Replaced("a.b.", ".", ".."), "a..b..");
    EXPECT_EQ(Replaced("abc", "", "x"), "abc");
    EXPECT_EQ(ReplacedNoCase("<b>MESSAGE</b> message", "Message", "Ä"), "<b>Ä</b> Ä");
}

TEST(TextTest, Splits) {
    EXPECT_THAT(Split("", ';'), IsEmpty());
    EXPECT_THAT(Split("a;;b", ';'), ElementsAre("a", "", "b"));
    EXPECT_THAT(Split(";", ';'), ElementsAre("", ""));
    EXPECT_EQ(Trimmed("  a b "), "a b");
    EXPECT_EQ(Trimmed("   "), "");
    EXPECT_EQ(Trimmed("\ta"), "\ta");
}

TEST(TextTest, NumbersAsPeopleTypeThem) {
    struct Row {
        const char* text;
        double number;
    };
    const Row rows[] = {
        {"1,5", 1.5},
        {"1.5", 1.5},
        {"  7 ", 7},
        {"+3", 3},
        {"+3,25", 3.25},
        {"-2", -2},
        {".5", 0.5},
        {"-,5", -0.5},
        {"5.", 5},
        {"1e3", 1000},
        {"1,5E-1", 0.15},
        {"0012", 12},
    };
    for (const Row& row : rows) EXPECT_EQ(ParseNumber(row.text), row.number) << row.text;
}

TEST(TextTest, WhatIsNoNumber) {
    for (const char* text :
         {"",   " ",   "abc", "1,5,5", "1.5,5", "1 234", "0x10",  "nan", "inf",   "1e", "1e+",
          "e3", "--1", "+-1", "+",     ".",     ",",     "1e999", "12a", "1e3.5", "١"}) {
        EXPECT_EQ(ParseNumber(text), std::nullopt) << text;
    }
    EXPECT_EQ(ParseNumber(std::string(100000, '9')), std::nullopt);
}

TEST(TextTest, Utf8OrBaltic) {
    EXPECT_EQ(Utf8FromEither("Märts ņ €"), "Märts ņ €");
    EXPECT_EQ(Utf8FromEither("M\xE4rts \xD5\xDE\xFE \x80 \xF2"), "Märts ÕŽž € ņ");
    EXPECT_EQ(Utf8FromEither("\xE2 \x81"), "ā \uFFFD");
    struct Row {
        const char* label;
        std::string bytes;
    };
    const Row rows[] = {
        {"alone", "\x80"},
        {"cut short", "a\xE2\x82"},
        {"overlong", "\xC0\xAF"},
        {"overlong of three", "\xE0\x80\xAF"},
        {"surrogate", "\xED\xA0\x80"},
        {"beyond the last", "\xF4\x90\x80\x80"},
        {"five bytes", "\xF8\x88\x80\x80\x80"},
    };
    for (const Row& row : rows) EXPECT_FALSE(IsValidUtf8(row.bytes)) << row.label;
    EXPECT_TRUE(IsValidUtf8("\xF4\x8F\xBF\xBF \xEF\xBF\xBD"));
}

TEST(TextTest, CountsCharactersNotBytes) {
    EXPECT_EQ(CharacterCount("õ€😀a"), 4U);
    EXPECT_EQ(FirstCharacters("õ€😀a", 0), "");
    EXPECT_EQ(FirstCharacters("õ€😀a", 2), "õ€");
    EXPECT_EQ(FirstCharacters("õ€😀a", 4), "õ€😀a");
    EXPECT_EQ(FirstCharacters("õ€", 9), "õ€");
    std::string text;
    for (const char32_t c : {U'a', U'õ', U'€', U'😀'}) AppendUtf8(text, c);
    EXPECT_EQ(text, "aõ€😀");
}

TEST(TextTest, LogLinesStayOneLine) {
    EXPECT_EQ(WithoutControls("a\r\nb\tc\x7F\x1B[0m"), "a  b c  [0m");
    EXPECT_EQ(WithoutControls("õ\u0085x\u2028y"), "õ x y");
}

TEST(TextTest, KeysIgnoreCase) {
    std::unordered_map<std::string, int, NoCaseHash, NoCaseEqual> map{{"Märts", 3}};
    EXPECT_TRUE(map.contains(std::string_view("MÄRTS")));
    EXPECT_FALSE(map.contains(std::string_view("MARTS")));
}

}  // namespace
}  // namespace zebtell::base
