#pragma once

#include <string>
#include <string_view>

namespace zebtell::base {

// The text written by one section of a text picture. Its places are filled from the right, with "!"
// from the left; characters that have no place follow the last one.
void AppendByTextPicture(std::string& out, std::string_view text, std::string_view section);

}  // namespace zebtell::base
