#pragma once

#include <string_view>

namespace zebtell::base {

// Whether the whole text matches: "*" any run, "?" one character, "#" a digit, "[abc]", "[a-z]",
// "[!abc]". Case is ignored, also of letters beyond ASCII. Takes time in proportion to text times
// pattern at the worst. RuntimeError 93 for a "[" without its "]" and for a range that runs
// backwards.
bool Like(std::string_view text, std::string_view pattern);

}  // namespace zebtell::base
