#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "data/data_application.h"

namespace zebtell::erp {

// The users of a company database as an administrator sees them. Works on a database file at once,
// beside a running portal, too; every function throws RuntimeError kUnspecified when the database
// is not there, and 5 for names that are not known or not possible.
class UserAdmin {
  public:
    UserAdmin(data::DatabaseType type, std::string path) : type_(type), path_(std::move(path)) {}

    struct NewUser {
        std::string name;
        std::string password;
        std::string display_name = {};
        std::string partner_code = {};  // GRCompany.Code; empty: no partner
        bool guest = false;
    };
    void Add(const NewUser& user);

    void SetPassword(std::string_view name, std::string_view password);
    // A disabled user can't log on; whoever is logged on already stays so until his session ends.
    void SetDisabled(std::string_view name, bool disabled);

    struct User {
        std::string name;
        std::string display_name;
        std::string partner_code;
        std::string partner_name;
        bool guest = false;
        bool disabled = false;
    };
    std::vector<User> List();  // by name

  private:
    data::DatabaseType type_;
    std::string path_;
};

}  // namespace zebtell::erp
