#include "base/like.h"

#include <gtest/gtest.h>

#include <chrono>
#include <string>

#include "base/runtime_error.h"

namespace zebtell::base {
namespace {

TEST(LikeTest, Matches) {
    struct Row {
        const char* text;
        const char* pattern;
        bool expected;
    };
    const Row rows[] = {
        {"", "", true},
        {"", "*", true},
        {"", "?", false},
        {"a", "", false},
        {"SAVE_x", "save_*", true},
        {"save", "save_*", false},
        {"zeb:len=10", "ZEB:*", true},
        {"(a,b)", "(*)", true},
        {"abcbc", "a*bc", true},
        {"abcbd", "a*bc", false},
        {"abXcdXef", "*x*x*", true},
        {"abc", "***c", true},
        {"aXb", "a?b", true},
        {"aõb", "a?b", true},
        {"a😀b", "a?b", true},
        {"aõõb", "a?b", false},
        {"a5", "a#", true},
        {"aa", "a#", false},
        {"a٥", "a#", false},
        {"õun", "ÕU*", true},
        {"ŽUUK", "[š-ž]uuk", true},
        {"q", "[a-z]", true},
        {"Q", "[a-z]", true},
        {"q", "[A-Z]", true},
        {"q", "[A-_]", true},
        {"5", "[a-z]", false},
        {"5", "[!a-z]", true},
        {"", "[!a-z]", false},
        {"b", "[abc]", true},
        {"-", "[-a]", true},
        {"-", "[a-]", true},
        {"-", "[!a-]", false},
        {"b", "[!-a]", true},
        {"-", "[!-a]", false},
        {"!", "[!]", true},
        {"a", "[!]", false},
        {"!", "[a!]", true},
        {"*", "[*]", true},
        {"x", "[*]", false},
        {"[x", "[[]x", true},
        {"x#?", "x[#][?]", true},
        {"a]b", "a]b", true},
        {"a]", "[a]]", true},
        {"", "[]", true},
        {"ab", "a[]b", true},
        {"a-b", "a*[]-[]*b", true},
        {"aõ", "a[õü]", true},
        {"\xFF", "?", true},
        {"\xFF", "\xFF*", true},
    };
    for (const Row& row : rows) {
        EXPECT_EQ(Like(row.text, row.pattern), row.expected) << row.text << " / " << row.pattern;
    }
}

TEST(LikeTest, RefusesBrokenLists) {
    for (const char* pattern : {"[", "a[b", "*[a-z", "[z-a]", "x*[!9-0]", "[]["}) {
        for (const char* text : {"", "a", "xb"}) {
            try {
                Like(text, pattern);
                ADD_FAILURE() << pattern;
            } catch (const RuntimeError& error) {
                EXPECT_EQ(error.number(), 93) << pattern;
            }
        }
    }
}

TEST(LikeTest, ManyStarsDoNotExplode) {
    std::string pattern;
    for (int i = 0; i < 200; ++i) pattern += "*a";
    const std::string text(2000, 'a');
    const auto start = std::chrono::steady_clock::now();
    EXPECT_FALSE(Like(text, pattern + "b"));
    EXPECT_TRUE(Like(text, pattern));
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(5));
}

}  // namespace
}  // namespace zebtell::base
