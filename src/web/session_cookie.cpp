#include "web/session_cookie.h"

#include "base/text.h"

namespace zebtell::web {
namespace {

constexpr std::string_view kName = "ZEBTell";

}  // namespace

std::vector<std::string_view> SessionTokens(const http::Request& request) {
    std::vector<std::string_view> tokens;
    for (const auto& [name, value] : request.headers) {
        if (!base::EqualNoCase(name, "Cookie")) continue;
        for (std::string_view cookie : base::Split(value, ';')) {
            cookie = base::Trimmed(cookie);
            if (cookie.starts_with(kName) && cookie.substr(kName.size()).starts_with('='))
                tokens.push_back(cookie.substr(kName.size() + 1));
        }
    }
    return tokens;
}

std::string SessionCookie(std::string_view token, std::string_view base_path, bool secure) {
    // "/portal" holds for "/portal" and "/portal/", "/portal/" for the second only.
    if (base_path.size() > 1 && base_path.ends_with('/')) base_path.remove_suffix(1);
    std::string cookie(kName);
    cookie.append("=").append(token).append("; Path=").append(base_path);
    cookie += "; HttpOnly; SameSite=Lax";
    if (secure) cookie += "; Secure";
    return cookie;
}

}  // namespace zebtell::web
