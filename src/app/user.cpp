#include <algorithm>
#include <iostream>

#include "app/commands.h"
#include "app/password_prompt.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "host/settings.h"

namespace zebtell::app {
namespace {

// The users of the database that the settings name.
erp::UserAdmin Users(const std::filesystem::path& folder) {
    const host::Settings settings = host::LoadSettings(folder);
    if (settings.Path.empty()) {
        throw base::RuntimeError(base::errors::kInvalidCall,
                                 "ZEBTell.ini names no database ([DataBase] Path)");
    }
    const bool is_file = settings.Type == data::DatabaseType::kSqlite;
    return {settings.Type, is_file ? (folder / settings.Path).string() : settings.Path};
}

std::string Kind(const erp::UserAdmin::User& user) {
    std::string kind = user.guest ? "guest" : "user";
    return user.disabled ? kind + ", disabled" : kind;
}

}  // namespace

int AddUser(const std::filesystem::path& folder, erp::UserAdmin::NewUser user) {
    user.password = ReadNewPassword(user.guest);
    Users(folder).Add(user);
    std::cout << "Added " << user.name << "\n";
    return 0;
}

int SetUserPassword(const std::filesystem::path& folder, const std::string& name) {
    erp::UserAdmin users = Users(folder);
    const auto all = users.List();
    const auto user = std::find_if(all.begin(), all.end(), [&](const erp::UserAdmin::User& each) {
        return base::EqualNoCase(each.name, name);
    });
    const bool may_be_empty = user != all.end() && user->guest;
    users.SetPassword(name, ReadNewPassword(may_be_empty));
    std::cout << "Changed the password of " << name << "\n";
    return 0;
}

int SetUserDisabled(const std::filesystem::path& folder, const std::string& name, bool disabled) {
    Users(folder).SetDisabled(name, disabled);
    std::cout << (disabled ? "Disabled " : "Enabled ") << name << "\n";
    return 0;
}

int ListUsers(const std::filesystem::path& folder) {
    for (const auto& user : Users(folder).List()) {
        std::cout << user.name << "\t" << Kind(user) << "\t" << user.display_name << "\t"
                  << user.partner_code << "\t" << user.partner_name << "\n";
    }
    return 0;
}

}  // namespace zebtell::app
