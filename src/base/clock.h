#pragma once

#include <functional>

#include "base/date_time.h"

namespace zebtell::base {

// The server's local time; tests hand in one of their own.
using Clock = std::function<DateTime()>;

}  // namespace zebtell::base
