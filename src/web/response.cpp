#include "web/response.h"

#include <algorithm>
#include <ctime>
#include <utility>

#include "base/runtime_error.h"
#include "base/text.h"
#include "http/http_date.h"

namespace zebtell::web {
namespace {

// What every page says unless it says otherwise: since it shows a customer's own figures, it is
// kept by no shared cache.
constexpr std::pair<std::string_view, std::string_view> kDefaultHeaders[] = {
    {"Content-Type", "text/html; charset=utf-8"},
    {"Cache-Control", "private"},
};

void RefuseLineBreaks(std::string_view text) {
    constexpr std::string_view kBreaks("\r\n\0", 3);
    if (text.find_first_of(kBreaks) != std::string_view::npos)
        throw base::RuntimeError(base::errors::kInvalidCall, "Line break in a header");
}

bool Has(const std::vector<http::Header>& headers, std::string_view name) {
    return std::any_of(headers.begin(), headers.end(), [&](const http::Header& header) {
        return base::EqualNoCase(header.first, name);
    });
}

std::string ExpiryDate(int minutes) {
    if (minutes <= 0) return "0";
    return http::FormatHttpDate(std::time(nullptr) + std::time_t{60} * minutes);
}

}  // namespace

void Response::Redirect(std::string address) {
    RefuseLineBreaks(address);
    redirect_ = std::move(address);
}

void Response::AddHeader(std::string name, std::string value) {
    RefuseLineBreaks(name);
    RefuseLineBreaks(value);
    if (name.empty() || name.find_first_of(": \t") != name.npos)
        throw base::RuntimeError(base::errors::kInvalidCall, "Bad header name");
    headers_.emplace_back(std::move(name), std::move(value));
}

void Response::SetCacheControl(std::string value) {
    RefuseLineBreaks(value);
    cache_control_ = std::move(value);
}

void Response::SetExpires(int minutes) {
    expires_minutes_ = minutes;
    has_expires_ = true;
}

void Response::SetStatus(int status) {
    if (status < 200 || status > 599) throw base::RuntimeError(base::errors::kInvalidCall);
    status_ = status;
}

void Response::Clear() {
    body_.clear();
    redirect_.clear();
    status_ = 200;
}

http::Response Response::Take() {
    Response taken = std::exchange(*this, {});
    http::Response response;
    response.status = taken.status_;
    response.headers = std::move(taken.headers_);
    auto& headers = response.headers;
    if (!taken.cache_control_.empty())
        headers.emplace_back("Cache-Control", std::move(taken.cache_control_));
    if (taken.has_expires_) headers.emplace_back("Expires", ExpiryDate(taken.expires_minutes_));
    for (const auto& [name, value] : kDefaultHeaders)
        if (!Has(headers, name)) headers.emplace_back(name, value);
    if (taken.redirect_.empty()) {
        response.body = std::move(taken.body_);
    } else {
        response.status = 303;
        headers.emplace_back("Location", std::move(taken.redirect_));
    }
    return response;
}

}  // namespace zebtell::web
