#pragma once

#include <exception>
#include <string>

#include "host/session_state.h"

namespace zebtell::host {

// An error as the log and the error page write it.
struct ErrorText {
    std::string number;       // "80040E14 (-2147217900)"
    std::string description;  // holds no markup
};

ErrorText DescribeError(const std::exception& error);

// 32-bit two's complement, upper case, no prefix.
std::string HexNumber(int number);

// The user's name, or "[No user]".
std::string UserPart(const SessionState& state);

}  // namespace zebtell::host
