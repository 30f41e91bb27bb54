#pragma once

#include <string>
#include <string_view>

namespace zebtell::erp::odbc {

std::u16string ToUtf16(std::string_view text);
// Halves of surrogate pairs become U+FFFD.
std::string FromUtf16(std::u16string_view text);

}  // namespace zebtell::erp::odbc
