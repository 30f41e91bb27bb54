#include "http/response_head.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <utility>

#include "base/text.h"
#include "http/http_date.h"

namespace zebtell::http {
namespace {

constexpr std::pair<int, std::string_view> kReasons[] = {
    {200, "OK"},
    {201, "Created"},
    {204, "No Content"},
    {206, "Partial Content"},
    {301, "Moved Permanently"},
    {302, "Found"},
    {303, "See Other"},
    {304, "Not Modified"},
    {307, "Temporary Redirect"},
    {308, "Permanent Redirect"},
    {400, "Bad Request"},
    {401, "Unauthorized"},
    {403, "Forbidden"},
    {404, "Not Found"},
    {405, "Method Not Allowed"},
    {408, "Request Timeout"},
    {410, "Gone"},
    {413, "Content Too Large"},
    {414, "URI Too Long"},
    {415, "Unsupported Media Type"},
    {417, "Expectation Failed"},
    {429, "Too Many Requests"},
    {431, "Request Header Fields Too Large"},
    {500, "Internal Server Error"},
    {501, "Not Implemented"},
    {503, "Service Unavailable"},
    {505, "HTTP Version Not Supported"},
};

// It loads nothing from other sites, is framed by its own only and loaded by its own only.
constexpr std::pair<std::string_view, std::string_view> kStrictHeaders[] = {
    {"X-Content-Type-Options", "nosniff"},
    {"Referrer-Policy", "same-origin"},
    {"X-Frame-Options", "SAMEORIGIN"},
    {"Cross-Origin-Opener-Policy", "same-origin"},
    {"Cross-Origin-Resource-Policy", "same-origin"},
    {"Content-Security-Policy",
     "default-src 'self'; frame-ancestors 'self'; form-action 'self'; base-uri 'self'; "
     "object-src 'none'"},
};

// For a year the browser comes by https only. Other hosts of the domain are not ours to bind.
constexpr std::string_view kStayWithTls = "Strict-Transport-Security: max-age=31536000\r\n";

std::string_view Reason(int status) {
    const auto* const found = std::find_if(std::begin(kReasons),
                                           std::end(kReasons),
                                           [&](const auto& row) { return row.first == status; });
    return found == std::end(kReasons) ? "Unknown" : found->second;
}

void AppendNumber(std::string& out, std::size_t number) {
    std::array<char, 24> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr;
    out.append(digits.data(), end);
}

// A header made of data must not be able to end its line and begin one of its own.
void AppendLineText(std::string& out, std::string_view text) {
    const bool is_clean = std::none_of(text.begin(), text.end(), [](char c) {
        return static_cast<unsigned char>(c) < ' ' || c == '\x7f';
    });
    if (is_clean) {
        out += text;
    } else {
        out += base::WithoutControls(text);
    }
}

void AppendHeader(std::string& out, std::string_view name, std::string_view value) {
    AppendLineText(out, name);
    out += ": ";
    AppendLineText(out, value);
    out += "\r\n";
}

bool Has(const Response& response, std::string_view name) {
    return std::any_of(response.headers.begin(), response.headers.end(), [&](const Header& header) {
        return header.first.size() == name.size() && base::EqualNoCase(header.first, name);
    });
}

std::string_view ConnectionHeader(After after) {
    switch (after) {
        case After::kKeepAliveHttp10:
            return "Connection: keep-alive\r\n";
        case After::kClose:
            return "Connection: close\r\n";
        case After::kKeepAlive:
            break;
    }
    return {};
}

}  // namespace

bool HasBody(int status) {
    return status != 204 && status != 304;
}

void AppendHead(std::string& out, const Response& response, std::string_view date, Sending how) {
    out += "HTTP/1.1 ";
    AppendNumber(out, static_cast<std::size_t>(response.status));
    out += ' ';
    out += Reason(response.status);
    out += "\r\nServer: ZEBTell\r\nDate: ";
    out += date;
    out += "\r\n";
    for (const auto& [name, value] : response.headers) AppendHeader(out, name, value);
    for (const auto& [name, value] : kStrictHeaders) {
        if (!Has(response, name)) AppendHeader(out, name, value);
    }
    if (how.secure) out += kStayWithTls;
    if (HasBody(response.status)) {
        out += "Content-Length: ";
        AppendNumber(out,
                     response.shared_body ? response.shared_body->size() : response.body.size());
        out += "\r\n";
    }
    out += ConnectionHeader(how.after);
    out += "\r\n";
}

Response ErrorResponse(int status) {
    Response response;
    response.status = status;
    response.headers = {{"Content-Type", "text/plain; charset=utf-8"},
                        {"Cache-Control", "no-store"}};
    if (status == 405) response.headers.emplace_back("Allow", "GET, HEAD, POST");
    AppendNumber(response.body, static_cast<std::size_t>(status));
    response.body += ' ';
    response.body += Reason(status);
    response.body += '\n';
    return response;
}

std::string_view DateHeader::Now() {
    const std::time_t now = std::time(nullptr);
    if (second_ != now) {
        second_ = now;
        text_ = FormatHttpDate(now);
    }
    return text_;
}

}  // namespace zebtell::http
