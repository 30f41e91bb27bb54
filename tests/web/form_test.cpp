#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "web/form_parser.h"
#include "web/request_reader.h"

namespace zebtell::web {
namespace {

using namespace std::string_view_literals;

std::string Shown(const std::vector<Field>& fields) {
    std::string text;
    for (const Field& field : fields) text += "[" + field.name + "=" + field.value + "]";
    return text;
}

TEST(Form, UrlEncoded) {
    const struct {
        std::string_view text;
        const char* expected;
    } rows[] = {
        {"", ""},
        {"a=1&b=2&a=3", "[a=1][b=2][a=3]"},
        {"a&=x&b=&&c==d", "[a=][=x][b=][c==d]"},
        {"n%61me=a+b%2Bc%26d", "[name=a b+c&d]"},
        {"x=%C3%B5&y=%F5&z=\xF5", "[x=\xC3\xB5][y=\xC3\xB5][z=\xC3\xB5]"},
        {"DE%00L=a\0b"sv,
         "[DE\xEF\xBF\xBDL=a\xEF\xBF\xBD"
         "b]"},
        {"a=%&b=%4&c=%zz", "[a=%][b=%4][c=%zz]"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(Shown(*ParseUrlEncoded(row.text)), row.expected) << row.text;
}

std::string ShownMultipart(std::string_view body, std::string_view boundary = "XX") {
    const MultipartForm form = ParseMultipart(body, boundary);
    return form.outcome == MultipartForm::Outcome::kRead ? Shown(form.fields) : "refused";
}

TEST(Form, Multipart) {
    const std::string part = "--XX\r\nContent-Disposition: form-data; name=\"a\"\r\n\r\n";
    const struct {
        const char* label;
        std::string body;
        const char* expected;
    } rows[] = {
        {"one field", part + "v\r\n--XX--\r\n", "[a=v]"},
        {"preamble", "hello\r\n" + part + "v\r\n--XX--", "[a=v]"},
        {"lines within", part + "1\r\n2\r\n\r\n-- XX\r\n--XX--", "[a=1\r\n2\r\n\r\n-- XX]"},
        {"two fields", part + "1\r\n" + part + "2\r\n--XX--", "[a=1][a=2]"},
        {"file",
         "--XX\r\nContent-Type: x/y\r\ncontent-disposition:form-data; filename=\"C:\\x;y.txt\"; "
         "name=\"f\"\r\n\r\nbytes\r\n--XX--",
         "[f=C:\\x;y.txt]"},
        {"quotes",
         "--XX\r\nContent-Disposition: form-data; name=\"q\\\"q\"\r\n\r\n\r\n--XX--",
         "[q\"q=]"},
        {"bare name",
         "--XX\r\nContent-Disposition: form-data; name=q \r\n\r\n\xF5\r\n--XX--",
         "[q=\xC3\xB5]"},
        {"no field", "--XX--", ""},
        {"no end", part + "v", "refused"},
        {"no name", "--XX\r\nContent-Disposition: form-data\r\n\r\nv\r\n--XX--", "refused"},
        {"no header", "--XX\r\n\r\nv\r\n--XX--", "refused"},
        {"open quote",
         "--XX\r\nContent-Disposition: form-data; name=\"a\r\n\r\nv\r\n--XX--",
         "refused"},
        {"nothing", "", "refused"},
    };
    for (const auto& row : rows) EXPECT_EQ(ShownMultipart(row.body), row.expected) << row.label;
    EXPECT_EQ(ShownMultipart(part + "v\r\n--XX--", ""), "refused");
    EXPECT_EQ(ShownMultipart(part + "v\r\n--XX--", std::string(71, 'X')), "refused");
    // Cut anywhere, it is refused and never read beyond its end.
    const std::string whole = part + "v\r\n--XX--";
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_EQ(ShownMultipart(std::string(whole, 0, size)), "refused") << size;
}

TEST(Form, FieldsKeepTheirOrderAndJoinTheirValues) {
    const FieldList list({{"b", "1"}, {"\xC3\x95", "2"}, {"B", "3"}, {"a", ""}});
    EXPECT_EQ(list["b"], "1, 3");
    EXPECT_EQ(list["\xC3\xB5"], "2");
    EXPECT_EQ(list["none"], "");
    EXPECT_TRUE(list.Has("A"));
    EXPECT_FALSE(list.Has("aa"));
    EXPECT_EQ(list.Item(3).name, "B");
    EXPECT_THROW(list.Item(0), base::RuntimeError);
    EXPECT_THROW(list.Item(5), base::RuntimeError);
    EXPECT_EQ(FieldList()["x"], "");
}

TEST(Form, ThousandsOfFieldsAreFoundByName) {
    std::string body;
    for (int i = 0; i < 5000; ++i) body += "&ID_" + std::to_string(i) + "=" + std::to_string(i * 2);
    const FieldList list(*ParseUrlEncoded(body));
    ASSERT_EQ(list.Count(), 5000U);
    for (int i = 0; i < 5000; ++i)
        ASSERT_EQ(list["id_" + std::to_string(i)], std::to_string(i * 2));
}

http::Request Posted(std::string type, std::string body) {
    return {.method = "POST",
            .target = "/?page=P&event=E%C3%B5&q=1%0A",
            .headers = {{"content-type", std::move(type)}},
            .body = std::move(body),
            .remote_address = "10.1.2.3"};
}

TEST(ParseRequest, ReadsAddressFormAndVariables) {
    const auto parsed =
        ParseRequest(Posted("Application/x-www-form-urlencoded; charset=utf-8", "q=2&Q=3"), "/");
    const auto& request = std::get<Request>(parsed);
    EXPECT_EQ(request.page, "P");
    EXPECT_EQ(request.event, "E\xC3\xB5");
    EXPECT_EQ(request.Form["q"], "2, 3");
    EXPECT_EQ(request.QueryString["q"], "1\n");
    EXPECT_EQ(request.Value("q"), "2, 3");
    EXPECT_EQ(request.Value("page"), "P");
    EXPECT_EQ(request.ServerVariables("query_string"), "page=P&event=E%C3%B5&q=1%0A");
    EXPECT_EQ(request.ServerVariables("REMOTE_HOST"), "10.1.2.3");
    EXPECT_EQ(request.ServerVariables("HTTP_COOKIE"), "");
}

TEST(ParseRequest, RefusesFormsItCannotRead) {
    std::string many;
    for (std::size_t i = 0; i <= kMaxFields; ++i) many += "a&";
    const struct {
        const char* label;
        http::Request request;
        int status;
    } rows[] = {
        {"too many fields", Posted("application/x-www-form-urlencoded", many), 413},
        {"no boundary", Posted("multipart/form-data", "--x"), 400},
        {"broken parts", Posted("multipart/form-data; boundary=x", "--y"), 400},
        {"no form", Posted("application/json", "{}"), 415},
        {"too long a query",
         {.method = "GET", .target = "/?" + many, .headers = {}, .body = {}, .remote_address = {}},
         413},
    };
    for (const auto& row : rows) {
        const auto parsed = ParseRequest(row.request, "/");
        ASSERT_TRUE(std::holds_alternative<Refusal>(parsed)) << row.label;
        EXPECT_EQ(std::get<Refusal>(parsed).status, row.status) << row.label;
    }
}

}  // namespace
}  // namespace zebtell::web
