#pragma once

#include <ctime>
#include <optional>
#include <string>
#include <string_view>

namespace zebtell::http {

// "Sun, 06 Nov 1994 08:49:37 GMT"
std::string FormatHttpDate(std::time_t time);
// Only that form; the two older ones count as no date.
std::optional<std::time_t> ParseHttpDate(std::string_view text);

}  // namespace zebtell::http
