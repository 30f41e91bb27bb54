#include "web/response.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"

namespace zebtell::web {
namespace {

std::string HeadersOf(const http::Response& response) {
    std::string text;
    for (const auto& [name, value] : response.headers) text += name + ": " + value + "\n";
    return text;
}

TEST(Response, IsAPrivatePageUnlessItSaysOtherwise) {
    Response response;
    response.Write("x");
    EXPECT_EQ(HeadersOf(response.Take()),
              "Content-Type: text/html; charset=utf-8\nCache-Control: private\n");
    EXPECT_TRUE(response.IsEmpty());
    response.AddHeader("content-type", "text/plain");
    response.AddHeader("Pragma", "no-cache");
    response.SetCacheControl("no-cache");
    response.SetExpires(-1);
    EXPECT_EQ(HeadersOf(response.Take()),
              "content-type: text/plain\nPragma: no-cache\nCache-Control: no-cache\n"
              "Expires: 0\n");
}

TEST(Response, RedirectHidesWhatWasWrittenAndClearTakesBothBack) {
    Response response;
    response.Write("x");
    response.Redirect("/?page=Logon");
    auto sent = response.Take();
    EXPECT_EQ(sent.status, 303);
    EXPECT_EQ(sent.body, "");
    EXPECT_EQ(sent.headers.back(), http::Header("Location", "/?page=Logon"));
    response.Redirect("/a");
    response.SetStatus(404);
    response.AddHeader("X-A", "1");
    response.Clear();
    response.Write("y");
    sent = response.Take();
    EXPECT_EQ(sent.status, 200);
    EXPECT_EQ(sent.body, "y");
    EXPECT_EQ(sent.headers.front(), http::Header("X-A", "1"));
}

TEST(Response, RefusesHeadersThatWouldBecomeTwo) {
    Response response;
    EXPECT_THROW(response.Redirect("/x\r\nSet-Cookie: a=b"), base::RuntimeError);
    EXPECT_THROW(response.AddHeader("X", "a\nb"), base::RuntimeError);
    EXPECT_THROW(response.AddHeader("X:Y", "a"), base::RuntimeError);
    EXPECT_THROW(response.AddHeader("", "a"), base::RuntimeError);
    EXPECT_THROW(response.SetCacheControl("a\rb"), base::RuntimeError);
    EXPECT_TRUE(response.IsEmpty());
}

}  // namespace
}  // namespace zebtell::web
