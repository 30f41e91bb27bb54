#pragma once

#include <string>

namespace zebtell::app {

// A new password: typed twice without being shown when standard input is a terminal, else one line
// of standard input. RuntimeError 5 when the two differ, when it has fewer than eight characters,
// and, unless `may_be_empty`, when there is none.
std::string ReadNewPassword(bool may_be_empty);

}  // namespace zebtell::app
