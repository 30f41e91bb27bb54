#pragma once

#include "host/session_state.h"

namespace zebtell::catalogue {

// How much of the current row's article the basket holds; 0 when it holds none. The basket is
// counted once a page: each row costs a look-up.
double QuantityInBasket(host::SessionState& state);

}  // namespace zebtell::catalogue
