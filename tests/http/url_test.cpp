#include "http/url.h"

#include <gtest/gtest.h>

#include "http/http_date.h"
#include "http/message.h"

namespace zebtell::http {
namespace {

TEST(Url, DecodesWhatIsValidAndLeavesTheRest) {
    const std::pair<const char*, const char*> rows[] = {
        {"a+b%20c", "a b c"},
        {"%C3%b5", "\xc3\xb5"},
        {"100%", "100%"},
        {"%4", "%4"},
        {"%zz%4g%", "%zz%4g%"},
        {"%%41", "%A"},
        {"%2541", "%41"},
    };
    for (const auto& [text, decoded] : rows) EXPECT_EQ(DecodeComponent(text), decoded) << text;
    EXPECT_EQ(DecodePath("a+b%20c"), "a+b c");
}

TEST(Url, EncodesEveryByteSoThatItComesBack) {
    EXPECT_EQ(EncodeComponent("Az09-._~ +&=/?%\"\xc3\xb5"),
              "Az09-._~%20%2B%26%3D%2F%3F%25%22%C3%B5");
    std::string all;
    for (int byte = 0; byte < 256; ++byte) all += static_cast<char>(byte);
    EXPECT_EQ(DecodeComponent(EncodeComponent(all)), all);
    EXPECT_EQ(DecodePath(EncodeComponent(all)), all);
}

TEST(Request, FindsHeadersAndSplitsTarget) {
    Request request;
    request.headers = {{"Host", "a"}, {"COOKIE", "1"}, {"Cookie", "2"}};
    EXPECT_EQ(request.HeaderValue("cookie"), "1");
    EXPECT_EQ(request.HeaderValue("Cook"), "");
    request.target = "/a?b?c";
    EXPECT_EQ(request.Path(), "/a");
    EXPECT_EQ(request.Query(), "b?c");
    request.target = "/a";
    EXPECT_EQ(request.Path(), "/a");
    EXPECT_EQ(request.Query(), "");
}

TEST(HttpDate, WritesAndReadsOneForm) {
    EXPECT_EQ(FormatHttpDate(784111777), "Sun, 06 Nov 1994 08:49:37 GMT");
    EXPECT_EQ(ParseHttpDate("Sun, 06 Nov 1994 08:49:37 GMT"), 784111777);
    for (const char* text : {"",
                             "Sunday, 06-Nov-94 08:49:37 GMT",
                             "Sun, 06 Nov 1994 08:49:37 CET",
                             "Sun, 06 Now 1994 08:49:37 GMT",
                             "Sun, -6 Nov 1994 08:49:37 GMT"}) {
        EXPECT_EQ(ParseHttpDate(text), std::nullopt) << text;
    }
}

}  // namespace
}  // namespace zebtell::http
