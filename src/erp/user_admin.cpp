#include "erp/user_admin.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "erp/connection.h"
#include "erp/database.h"
#include "erp/password.h"
#include "erp/write_sql.h"

namespace zebtell::erp {
namespace {

[[noreturn]] void Refuse(const char* why) {
    throw base::RuntimeError(base::errors::kInvalidCall, why);
}

std::int64_t IdOf(Connection& connection, const BoundSql& sql) {
    const auto row = connection.Query(sql);
    return row->Next() ? row->GetInteger(0) : 0;
}

std::int64_t UserId(Connection& connection, std::string_view name) {
    const auto row = connection.Query({"SELECT ID, Name FROM SYUser", {}});
    while (row->Next()) {
        if (base::EqualNoCase(row->Get(1).ToPlainText(), name)) {
            return row->GetInteger(0);
        }
    }
    return 0;
}

void ChangeUser(Connection& connection, std::string_view name, const ColumnValues& values) {
    const std::int64_t id = UserId(connection, name);
    if (id == 0) {
        Refuse("There is no such user");
    }
    connection.Execute(UpdateSql("SYUser", id, values));
}

base::Value PartnerOf(Connection& connection, const std::string& code) {
    if (code.empty()) {
        return base::Value::Null();
    }
    const std::int64_t id = IdOf(connection, {"SELECT ID FROM GRCompany WHERE Code = ?", {code}});
    if (id == 0) {
        Refuse("There is no company of that code");
    }
    return id;
}

}  // namespace

void UserAdmin::Add(const NewUser& user) {
    if (base::Trimmed(user.name).empty() || base::Trimmed(user.name) != user.name) {
        Refuse("A user's name is not empty and has no blanks around it");
    }
    const auto connection = MakeBackend(type_, path_)->Connect(Access::kWrite);
    if (UserId(*connection, user.name) != 0) {
        Refuse("There is a user of that name");
    }
    connection->Execute(InsertSql("SYUser",
                                  {{"Name", user.name},
                                   {"PasswordHash", HashPassword(user.password)},
                                   {"DisplayName", user.display_name},
                                   {"IDPartner", PartnerOf(*connection, user.partner_code)},
                                   {"Guest", user.guest},
                                   {"Disabled", false}}));
}

void UserAdmin::SetPassword(std::string_view name, std::string_view password) {
    const auto connection = MakeBackend(type_, path_)->Connect(Access::kWrite);
    ChangeUser(*connection, name, {{"PasswordHash", HashPassword(password)}});
}

void UserAdmin::SetDisabled(std::string_view name, bool disabled) {
    const auto connection = MakeBackend(type_, path_)->Connect(Access::kWrite);
    ChangeUser(*connection, name, {{"Disabled", disabled}});
}

std::vector<UserAdmin::User> UserAdmin::List() {
    const auto connection = MakeBackend(type_, path_)->Connect(Access::kRead);
    const auto row = connection->Query(
        {"SELECT u.Name, u.DisplayName, c.Code, c.Name, u.Guest, u.Disabled FROM SYUser u "
         "LEFT JOIN GRCompany c ON c.ID = u.IDPartner ORDER BY u.Name",
         {}});
    std::vector<User> users;
    while (row->Next()) {
        users.push_back({row->Get(0).ToPlainText(),
                         row->Get(1).ToPlainText(),
                         row->Get(2).ToPlainText(),
                         row->Get(3).ToPlainText(),
                         row->GetInteger(4) != 0,
                         row->GetInteger(5) != 0});
    }
    return users;
}

}  // namespace zebtell::erp
