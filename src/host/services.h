#pragma once

#include <functional>
#include <string>

#include "base/clock.h"
#include "data/data_application.h"
#include "host/logon_limits.h"
#include "host/settings.h"

namespace zebtell::host {

// What all sessions share. Owned by the program, outlives every session.
struct Services {
    SettingsStore& settings;
    data::DataApplicationFactory make_application;
    base::Clock clock;
    // What changes with the bytes of a static file; none: nothing is known of them.
    std::function<std::string(const std::string& name)> file_version{};
    LogonLimits logon_limits{};
};

}  // namespace zebtell::host
