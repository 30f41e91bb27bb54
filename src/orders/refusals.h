#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "host/session_state.h"

namespace zebtell::orders {

// What a form asked for and did not get, for the message to the user.
class Refusals {
  public:
    // `what` is a row's or article's name, `typed` what stood in its box.
    void Add(std::string_view what, std::string_view typed);

    // Sets the session's Message when there is something to say.
    void Tell(host::SessionState& state) const;

  private:
    std::vector<std::string> items_;
};

}  // namespace zebtell::orders
