#pragma once

#include <cstdint>
#include <string>

#include "base/date_time.h"

namespace zebtell::host {

// Failed log-ons of this session.
struct BlockingState {
    std::string LastAttemptedName;
    base::DateTime LastFailure;
    std::int16_t FailedAttempts = 0;
    bool Blocked = false;
};

}  // namespace zebtell::host
