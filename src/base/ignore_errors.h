#pragma once

#include <exception>

namespace zebtell::base {

// Runs a stretch of which a failure must not stop the work, such as a running total or an optional
// conversion. Returns whether it came to its end. Nothing else in the portal drops an error.
template <class Work>
bool IgnoreErrors(Work&& work) {
    try {
        work();
        return true;
    } catch (const std::exception&) {
        return false;
    }
}

}  // namespace zebtell::base
