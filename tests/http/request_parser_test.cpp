#include "http/request_parser.h"

#include <gmock/gmock.h>

#include <string>
#include <vector>

namespace zebtell::http {
namespace {

using State = RequestParser::State;

const std::string kHost = "Host: shop\r\n";

// What came of the bytes: "POST /a|X=1|body" for each request, then "400" for a refusal or "..."
// when the last request has not ended. The bytes are handed in `step` at a time.
std::string Parsed(const std::string& bytes, std::size_t first, std::size_t step) {
    const Limits limits;
    RequestParser parser(limits);
    std::string waiting;
    std::string out;
    for (std::size_t at = 0; at < bytes.size();) {
        const std::size_t count = at == 0 ? first : step;
        waiting += bytes.substr(at, count);
        at += count;
        while (true) {
            waiting.erase(0, parser.Take(waiting));
            if (parser.state() == State::kRefused) return out + std::to_string(parser.refusal());
            if (parser.state() != State::kDone) break;
            const Request request = parser.TakeRequest();
            out += request.method + " " + request.target + "|";
            for (const auto& [name, value] : request.headers) out += name + "=" + value + ";";
            out += "|" + request.body + "\n";
            parser.Reset();
            if (waiting.empty()) break;
        }
    }
    return parser.has_begun() ? out + "..." : out;
}

std::string Parsed(const std::string& bytes) {
    return Parsed(bytes, bytes.size(), 1);
}

std::string Post(const std::string& headers, const std::string& body = "") {
    return "POST / HTTP/1.1\r\n" + kHost + headers + "\r\n" + body;
}

std::string Chunked(const std::string& body) {
    return Post("Transfer-Encoding: chunked\r\n", body);
}

std::string Line(const std::string& line) {
    return line + "\r\n" + kHost + "\r\n";
}

struct Row {
    const char* label;
    std::string bytes;
    std::string expected;
};
void PrintTo(const Row& row, std::ostream* out) {
    *out << row.label;
}

class ParserRows : public ::testing::TestWithParam<Row> {};

// Wherever the bytes are cut on their way, the outcome is the same; though a head that came in
// pieces may be refused only when it has ended, which is why most rows have a whole one.
TEST_P(ParserRows, OutcomeAtEveryCut) {
    const auto& [label, bytes, expected] = GetParam();
    ASSERT_EQ(Parsed(bytes), expected);
    EXPECT_EQ(Parsed(bytes, 1, 1), expected) << "byte by byte";
    if (bytes.size() > 1000) return;
    for (std::size_t cut = 1; cut < bytes.size(); ++cut) {
        ASSERT_EQ(Parsed(bytes, cut, bytes.size()), expected) << "cut at " << cut;
    }
}

const std::string kEchoed = "POST /|Host=shop;";

INSTANTIATE_TEST_SUITE_P(
    Accepted,
    ParserRows,
    ::testing::Values(
        Row{"get",
            "GET /a?b=%20c HTTP/1.1\r\nHost: shop\r\nX:  y z \r\n\r\n",
            "GET /a?b=%20c|Host=shop;X=y z;|\n"},
        Row{"http 1.0 without host", "GET / HTTP/1.0\r\n\r\n", "GET /||\n"},
        Row{"length",
            Post("Content-Length: 5\r\n", "hello"),
            kEchoed + "Content-Length=5;|hello\n"},
        Row{"chunks, extension and trailer",
            Post("Transfer-Encoding: Chunked\r\n",
                 "5;a=b\r\nhello\r\n00A\r\n, my world\r\n0\r\nX-Forwarded-For: 1.2.3.4\r\n\r\n"),
            kEchoed + "Transfer-Encoding=Chunked;|hello, my world\n"},
        Row{"nothing but the last chunk",
            Chunked("0\r\n\r\n"),
            kEchoed + "Transfer-Encoding=chunked;|\n"},
        Row{"pipelined, empty line between",
            Post("Content-Length: 2\r\n", "ab") + "\r\nGET /2 HTTP/1.0\r\n\r\nHEAD /3",
            kEchoed + "Content-Length=2;|ab\nGET /2||\n..."},
        Row{"escaped line break in the query",
            "GET /?t=%0D%0A/../ HTTP/1.0\r\n\r\n",
            "GET /?t=%0D%0A/../||\n"},
        Row{"dots in names",
            "GET /a..b/.well/v1.2/... HTTP/1.0\r\n\r\n",
            "GET /a..b/.well/v1.2/...||\n"}));

INSTANTIATE_TEST_SUITE_P(
    Smuggling,
    ParserRows,
    ::testing::Values(
        Row{"two lengths", Post("Content-Length: 1\r\nContent-Length: 2\r\n", "ab"), "400"},
        Row{"same length twice", Post("Content-Length: 1\r\nContent-Length: 1\r\n", "a"), "400"},
        Row{"length list", Post("Content-Length: 1, 1\r\n", "a"), "400"},
        Row{"signed length", Post("Content-Length: +1\r\n", "a"), "400"},
        Row{"hex length", Post("Content-Length: 0x1\r\n", "a"), "400"},
        Row{"empty length", Post("Content-Length:\r\n"), "400"},
        Row{"length beyond 64 bits", Post("Content-Length: 18446744073709551617\r\n", "a"), "400"},
        Row{"length, coding",
            Post("Content-Length: 5\r\nTransfer-Encoding: chunked\r\n", "0\r\n\r\n"),
            "400"},
        Row{"coding, length",
            Post("Transfer-Encoding: chunked\r\nContent-Length: 5\r\n", "0\r\n\r\n"),
            "400"},
        Row{"two codings",
            Post("Transfer-Encoding: chunked\r\nTransfer-Encoding: chunked\r\n"),
            "400"},
        Row{"other coding", Post("Transfer-Encoding: gzip\r\n"), "501"},
        Row{"coding list", Post("Transfer-Encoding: gzip, chunked\r\n"), "501"},
        Row{"coding with a hidden character", Post("Transfer-Encoding: \x0b chunked\r\n"), "400"},
        Row{"coding in 1.0",
            "POST / HTTP/1.0\r\nTransfer-Encoding: chunked\r\n\r\n0\r\n\r\n",
            "400"},
        Row{"blank before colon", Post("Transfer-Encoding : chunked\r\n"), "400"},
        Row{"folded", Post("X: a\r\n b\r\n"), "400"},
        Row{"folded at once", Post("X:\r\n b\r\n"), "400"},
        Row{"folded to nothing", Post("X: a\r\n \r\n"), "400"},
        Row{"bare line feed", "GET / HTTP/1.1\nHost: shop\n\n\r\n\r\n", "400"},
        Row{"bare line feed in a header", Post("X: a\nTransfer-Encoding: chunked\r\n"), "400"},
        Row{"bare carriage return", Post("X: a\rb\r\n"), "400"},
        Row{"NUL", Post(std::string("X: a\0b\r\n", 8)), "400"},
        Row{"no name", Post(": a\r\n"), "400"},
        Row{"no colon", Post("X\r\n"), "400"},
        Row{"chunk size not a number", Chunked("x\r\n"), "400"},
        Row{"chunk size negative", Chunked("-1\r\n"), "400"},
        Row{"chunk size beyond 64 bits", Chunked("10000000000000001\r\na"), "400"},
        Row{"chunk longer than its size", Chunked("1\r\nab\r\n0\r\n\r\n"), "400"},
        Row{"chunk size ended by a line feed", Chunked("1\na\r\n0\r\n\r\n"), "400"},
        Row{"line break in an extension", Chunked("1;a=\"\r\n\"\r\na\r\n0\r\n\r\n"), "400"}));

INSTANTIATE_TEST_SUITE_P(
    Refused,
    ParserRows,
    ::testing::Values(
        Row{"no host", "GET / HTTP/1.1\r\n\r\n", "400"},
        Row{"two hosts", "GET / HTTP/1.1\r\nHost: a\r\nHost: b\r\n\r\n", "400"},
        Row{"empty host", "GET / HTTP/1.1\r\nHost:\r\n\r\n", "400"},
        Row{"host with a path", "GET / HTTP/1.1\r\nHost: a/b\r\n\r\n", "400"},
        Row{"two hosts in 1.0", "GET / HTTP/1.0\r\nHost: a\r\nHost: a\r\n\r\n", "400"},
        Row{"known method", Line("DELETE / HTTP/1.1"), "405"},
        Row{"unknown method", Line("get / HTTP/1.1"), "501"},
        Row{"absolute form", Line("GET http://shop/ HTTP/1.1"), "400"},
        Row{"no path", Line("GET a HTTP/1.1"), "400"},
        Row{"fragment", Line("GET /#a HTTP/1.1"), "400"},
        Row{"raw UTF-8", Line("GET /\xc3\xb5 HTTP/1.1"), "400"},
        Row{"dotted", Line("GET /static/../zebtell.ini HTTP/1.1"), "400"},
        Row{"dotted at the end", Line("GET /static/.. HTTP/1.1"), "400"},
        Row{"encoded dots", Line("GET /static/%2e%2E/a HTTP/1.1"), "400"},
        Row{"encoded slash", Line("GET /static/..%2fa HTTP/1.1"), "400"},
        Row{"backslash", Line("GET /static/..%5ca HTTP/1.1"), "400"},
        Row{"single dot", Line("GET /./a HTTP/1.1"), "400"},
        Row{"encoded NUL", Line("GET /a%00.css HTTP/1.1"), "400"},
        Row{"other version", Line("GET / HTTP/2.0"), "505"},
        Row{"no version", Line("GET /"), "400"},
        Row{"blank in the target", Line("GET /a b HTTP/1.1"), "400"},
        Row{"expectation", Post("Expect: tea\r\n"), "417"},
        Row{"not HTTP", "\x16\x03\x01\x02", "400"},
        Row{"long line", Line("GET /" + std::string(9000, 'a') + " HTTP/1.1"), "414"},
        Row{"line without end", "GET /" + std::string(9000, 'a'), "414"},
        Row{"large header", Post("X: " + std::string(17000, 'a') + "\r\n"), "431"},
        Row{"header without end",
            "GET / HTTP/1.1\r\n" + kHost + "X: " + std::string(17000, 'a'),
            "431"},
        Row{"large body", Post("Content-Length: 1048577\r\n"), "413"},
        Row{"large chunk", Chunked("100001\r\n"), "413"},
        Row{"chunk extension without end", Chunked("1;" + std::string(17000, 'a')), "400"}));

std::string Headers(int count, const std::string& value) {
    std::string headers;
    for (int i = 0; i < count; ++i) headers += "X: " + value + "\r\n";
    return headers;
}

TEST(RequestParser, CountsAndAddsUpHeaders) {
    EXPECT_THAT(Parsed(Post(Headers(99, "a"))), ::testing::EndsWith("X=a;|\n"));
    EXPECT_EQ(Parsed(Post(Headers(100, "a"))), "431");
    EXPECT_EQ(Parsed(Post(Headers(90, std::string(200, 'a')))), "431");
    EXPECT_EQ(Parsed(Chunked("0\r\n" + Headers(90, std::string(200, 'a')) + "\r\n")), "431");
}

TEST(RequestParser, LimitsWholeBodyOfSmallChunks) {
    const std::string chunk = "10000\r\n" + std::string(0x10000, 'a') + "\r\n";
    std::string body;
    for (int i = 0; i < 16; ++i) body += chunk;
    EXPECT_EQ(Parsed(Chunked(body + "0\r\n\r\n")).size(),
              kEchoed.size() + sizeof("Transfer-Encoding=chunked;|") + 1024 * 1024);
    EXPECT_EQ(Parsed(Chunked(body + "1\r\na\r\n")), "413");
}

// A request line that came in pieces makes the library wait for the whole head; long headers are
// then still headers.
TEST(RequestParser, TellsLongLineFromLongHeadersWhenInPieces) {
    const std::string request = "GET / HTTP/1.1\r\nHost: shop\r\nX: " + std::string(15000, 'a');
    EXPECT_EQ(Parsed(request, 1, 1000), "...");
    EXPECT_EQ(Parsed(request + std::string(2000, 'a'), 1, 1000), "431");
}

}  // namespace
}  // namespace zebtell::http
