#pragma once

#include <vector>

#include "host/session_state.h"

namespace zebtell::app {

// Every page of the portal.
std::vector<host::Page> PortalPages();

}  // namespace zebtell::app
