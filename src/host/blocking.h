#pragma once

#include <string>
#include <string_view>

#include "host/session_state.h"

namespace zebtell::host {

// Whether the session is blocked now; a block that has run out is lifted.
bool IsBlocked(SessionState& state, const Settings& settings);

// Counts a failed log-on and blocks the session when there were too many.
void CountFailure(SessionState& state, const Settings& settings, std::string_view user);

std::string BlockedMessage(const Settings& settings);

}  // namespace zebtell::host
