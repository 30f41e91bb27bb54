#pragma once

#include <filesystem>
#include <functional>
#include <string>

#include "demo/demo_company.h"
#include "host/server_settings.h"

namespace zebtell::app {

// The commands of the program. Each returns its exit status; RuntimeError says what went wrong.

// Serves until SIGTERM or SIGINT. `override` has the command line's word on the settings.
int Serve(const std::filesystem::path& folder,
          const std::function<void(host::ServerSettings&)>& override);

// Makes the demo company and its settings file in `folder`, unless it is there, and says who can
// log on.
int MakeDemo(const std::filesystem::path& folder,
             const std::filesystem::path& templates,
             const demo::DemoOptions& options);

}  // namespace zebtell::app
