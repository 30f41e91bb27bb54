#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "host/session_state.h"

namespace zebtell::orders {

// The form field of the quick entry's lines. Refused ones come back in it, one below the other.
inline constexpr std::string_view kQuickEntryBox = "QuickEntry";

// What a form asked for and did not get, for the message to the user.
class Refusals {
  public:
    // `what` is a row's or article's name, `typed` what stood in the form field `box`.
    void Add(std::string_view what, std::string_view typed, std::string_view box = {});

    // Sets the session's Message when there is something to say, and keeps what was typed for the
    // form that is shown again.
    void Tell(host::SessionState& state) const;

  private:
    std::vector<std::string> items_;
    decltype(host::FormOutcome::Refused) boxes_;
};

}  // namespace zebtell::orders
