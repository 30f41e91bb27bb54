#pragma once

#include <string_view>

namespace zebtell::http {

// Whether a request's target is one that the portal answers: an absolute path with an optional
// query, printable ASCII without "#". In the path, also percent-encoded ones count: no "." or ".."
// segment, no backslash before such a segment, no control character.
bool IsAcceptableTarget(std::string_view target);

// Whether a Host header names a host ("shop.example:8080", "[::1]:80"); not whether it is ours.
bool IsAcceptableHost(std::string_view host);

}  // namespace zebtell::http
