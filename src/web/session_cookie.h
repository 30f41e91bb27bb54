#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "http/message.h"

namespace zebtell::web {

// The session tokens that a browser sends: mostly one, more when cookies of several paths reach us.
std::vector<std::string_view> SessionTokens(const http::Request& request);

// The Set-Cookie header's value. Scripts cannot read the cookie, other sites' posts do not carry
// it, and it goes with the browser's window.
std::string SessionCookie(std::string_view token, std::string_view base_path, bool secure);

}  // namespace zebtell::web
