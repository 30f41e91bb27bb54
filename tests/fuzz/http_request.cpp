#include <algorithm>
#include <vector>

#include "base/text.h"
#include "http/client_address.h"
#include "http/request_parser.h"
#include "http/target.h"
#include "tests/fuzz/harness.h"

// The first line says in how many bytes at a time the others come; they are what a client sends
// over one connection.

namespace zebtell::fuzz {
namespace {

using http::Request;
using http::RequestParser;
using State = RequestParser::State;

struct Connection {
    std::vector<Request> requests;
    int refusal = 0;
    bool has_rest = false;  // a request has begun and not ended
};

http::Limits SmallLimits() {
    http::Limits limits;
    limits.request_line_bytes = 200;
    limits.header_bytes = 400;
    limits.header_count = 10;
    limits.body_bytes = 300;
    return limits;
}

Connection Read(std::string_view bytes, std::size_t step) {
    const http::Limits limits = SmallLimits();
    RequestParser parser(limits);
    Connection read;
    std::string waiting;
    while (!bytes.empty()) {
        waiting += bytes.substr(0, step);
        bytes.remove_prefix(std::min(step, bytes.size()));
        for (bool goes_on = true; goes_on;) {
            const std::size_t taken = parser.Take(waiting);
            Claim(taken <= waiting.size(), "nothing is taken that was not there");
            waiting.erase(0, taken);
            if (parser.state() == State::kRefused) {
                read.refusal = parser.refusal();
                return read;
            }
            goes_on = parser.state() == State::kDone;
            if (!goes_on) continue;
            read.requests.push_back(parser.TakeRequest());
            parser.Reset();
        }
        Claim(waiting.size() <= limits.request_line_bytes + limits.header_bytes + step,
              "what waits is bounded");
    }
    read.has_rest = parser.has_begun();
    return read;
}

bool HasOnly(std::string_view text, bool (*allowed)(char)) {
    return std::all_of(text.begin(), text.end(), allowed);
}

bool IsNameCharacter(char c) {
    return c > ' ' && c < '\x7f' &&
           std::string_view("()<>@,;:\\\"/[]?={}").find(c) == std::string_view::npos;
}

bool IsValueCharacter(char c) {
    return c == '\t' || (static_cast<unsigned char>(c) >= ' ' && c != '\x7f');
}

std::size_t Count(const Request& request, std::string_view name) {
    return static_cast<std::size_t>(
        std::count_if(request.headers.begin(), request.headers.end(), [&](const auto& header) {
            return base::EqualNoCase(header.first, name);
        }));
}

// What holds for a request that anybody behind the parser gets to see.
void CheckRequest(const Request& request) {
    const http::Limits limits = SmallLimits();
    Claim(request.method == "GET" || request.method == "HEAD" || request.method == "POST",
          "the method is one of three");
    Claim(http::IsAcceptableTarget(request.target), "the target is a plain path");
    Claim(request.target.size() <= limits.request_line_bytes, "the target is bounded");
    Claim(request.body.size() <= limits.body_bytes, "the body is bounded");
    Claim(request.headers.size() <= limits.header_count, "the headers are bounded");
    for (const auto& [name, value] : request.headers) {
        Claim(!name.empty() && HasOnly(name, IsNameCharacter), "header names are words", name);
        Claim(HasOnly(value, IsValueCharacter), "header values are one line", value);
    }
    const std::size_t lengths = Count(request, "Content-Length");
    Claim(Count(request, "Host") <= 1, "there is one host");
    Claim(lengths + Count(request, "Transfer-Encoding") <= 1, "there is one length");
    Claim(lengths == 0 || request.HeaderValue("Content-Length").find_first_not_of("0123456789") ==
                              std::string_view::npos,
          "the length is a number");
    Claim(lengths == 0 || std::stoull(std::string(request.HeaderValue("Content-Length"))) ==
                              request.body.size(),
          "the body is as long as announced");
}

// As a proxy would pass it on: with a length, without codings and what is meant for itself.
std::string Written(const Request& request) {
    std::string bytes = request.method + " " + request.target + " HTTP/1.1\r\n";
    for (const auto& [name, value] : request.headers) {
        const bool is_left_out = base::EqualNoCase(name, "Transfer-Encoding") ||
                                 base::EqualNoCase(name, "Content-Length") ||
                                 base::EqualNoCase(name, "Expect");
        if (!is_left_out) bytes += name + ": " + value + "\r\n";
    }
    if (Count(request, "Host") == 0) bytes += "Host: h\r\n";
    return bytes + "Content-Length: " + std::to_string(request.body.size()) + "\r\n\r\n" +
           request.body;
}

bool IsTooLong(int status) {
    return status == 414 || status == 431;
}

void CheckPassedOn(const Request& request) {
    const std::string bytes = Written(request);
    if (bytes.size() > 600 || request.headers.size() + 2 > SmallLimits().header_count) return;
    const Connection again = Read(bytes, bytes.size());
    if (IsTooLong(again.refusal)) return;
    Claim(again.refusal == 0 && again.requests.size() == 1, "it is one request again", bytes);
    Claim(again.requests[0].target == request.target && again.requests[0].body == request.body,
          "it is the same request",
          bytes);
}

void CheckClient(Request request) {
    static const http::TrustedProxies proxies({"127.0.0.1", "10.0.0.0/8"});
    proxies.SetClient(request, "127.0.0.1", false);
    Claim(http::IpAddress::Parse(request.remote_address).has_value(), "a client is an address");
}

bool Same(const Request& a, const Request& b) {
    return a.method == b.method && a.target == b.target && a.headers == b.headers &&
           a.body == b.body;
}

}  // namespace

void Try(std::string_view input) {
    const std::string step_text(TakeLine(input));
    const std::size_t step = 1 + static_cast<std::size_t>(std::atoi(step_text.c_str())) % 100;
    const Connection whole = Read(input, input.size() + 1);
    const Connection split = Read(input, step);
    for (const Request& request : whole.requests) {
        CheckRequest(request);
        CheckPassedOn(request);
        CheckClient(request);
    }
    // In pieces a head is too long a few bytes earlier.
    if (IsTooLong(split.refusal)) return;
    Claim(std::equal(whole.requests.begin(),
                     whole.requests.end(),
                     split.requests.begin(),
                     split.requests.end(),
                     Same),
          "wherever the bytes are cut, the requests are the same");
    // What has not ended may be refused now or when it has.
    Claim((whole.refusal != 0) == (split.refusal != 0) || whole.has_rest || split.has_rest,
          "wherever the bytes are cut, the same is refused",
          std::to_string(whole.refusal) + " or " + std::to_string(split.refusal));
}

}  // namespace zebtell::fuzz
