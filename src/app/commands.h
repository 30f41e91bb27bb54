#pragma once

#include <filesystem>
#include <functional>
#include <string>

#include "demo/demo_company.h"
#include "erp/user_admin.h"
#include "host/server_settings.h"

namespace zebtell::app {

// The commands of the program. Each returns its exit status; RuntimeError says what went wrong.

// Serves until SIGTERM or SIGINT. `override` has the command line's word on the settings.
int Serve(const std::filesystem::path& folder,
          const std::function<void(host::ServerSettings&)>& override);

// Makes the demo company and its settings file in `folder`, unless it is there, and says who can
// log on.
int MakeDemo(const std::filesystem::path& folder, const demo::DemoOptions& options);

// Says what is wrong with the settings, the database and the templates; 1 when anything is.
// `templates` is empty for the folder that the settings name; `default_templates` are those that
// came with the program.
int Check(const std::filesystem::path& folder,
          const std::filesystem::path& templates,
          const std::filesystem::path& default_templates);

// Prints the texts that the templates of a folder mark to be translated, as gettext's tools read
// them, each with the files and lines where it stands.
int PrintTexts(const std::filesystem::path& templates);

// Users of the database that the settings name. Passwords are asked for.
int AddUser(const std::filesystem::path& folder, erp::UserAdmin::NewUser user);
int SetUserPassword(const std::filesystem::path& folder, const std::string& name);
int SetUserDisabled(const std::filesystem::path& folder, const std::string& name, bool disabled);
int ListUsers(const std::filesystem::path& folder);

}  // namespace zebtell::app
