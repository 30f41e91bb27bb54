#include "erp/logon.h"

#include <algorithm>
#include <optional>
#include <string>

#include "base/runtime_error.h"
#include "base/text.h"
#include "erp/password.h"

namespace zebtell::erp {
namespace {

constexpr const char* kUserSql =
    "SELECT u.ID, u.PasswordHash, u.Guest, u.Disabled, u.IDPartner, u.IDGRCompContPerson, "
    "c.IDSettlCompany, c.IDParent, c.IDEREmployee, c.IDGRCompanyPriceCat, "
    "c.IDGRPriceList, s.IDGRPriceList "
    "FROM SYUser u LEFT JOIN GRCompany c ON c.ID = u.IDPartner "
    "LEFT JOIN GRCompany s ON s.ID = c.IDSettlCompany WHERE u.Name = ?";

struct User {
    Reader reader;
    std::string hash;
    bool disabled = false;
    std::int64_t price_list = 0;  // 0: neither the partner nor who pays for it has one
};

std::optional<User> ReadUser(Connection& connection, std::string_view name) {
    const auto row = connection.Query({kUserSql, {name}});
    if (!row->Next()) {
        return std::nullopt;
    }
    User user;
    user.reader.user = row->GetInteger(0);
    user.hash = row->Get(1).ToPlainText();
    user.reader.role = row->GetInteger(2) != 0 ? Role::kGuest : Role::kUser;
    user.disabled = row->GetInteger(3) != 0;
    user.reader.partner = row->GetInteger(4);
    user.reader.contact = row->GetInteger(5);
    user.reader.settlement_company = row->GetInteger(6);
    user.reader.parent = row->GetInteger(7);
    user.reader.employee = row->GetInteger(8);
    user.reader.price_category = row->GetInteger(9);
    const std::int64_t own = row->GetInteger(10);
    user.price_list = own != 0 ? own : row->GetInteger(11);
    return user;
}

// The name in the letters that the database has, where it knows it. Databases compare names without
// regard to case, though not all of them letters beyond ASCII. All names are read whoever it is, so
// that the time does not tell which ones there are.
std::string NameAsKnown(Connection& connection, std::string_view name) {
    const auto row = connection.Query({"SELECT Name FROM SYUser", {}});
    std::string found(name);
    bool is_exact = false;
    while (row->Next()) {
        std::string known = row->Get(0).ToPlainText();
        if (is_exact || !base::EqualNoCase(known, name)) continue;
        is_exact = known == name;
        found = std::move(known);
    }
    return found;
}

std::optional<User> FindUser(Connection& connection, std::string_view name) {
    return ReadUser(connection, NameAsKnown(connection, name));
}

// The lines of a list may be those of another one; whoever sees them reads them there.
std::vector<std::int64_t> WithSourceLists(Connection& connection,
                                          const std::vector<std::int64_t>& own) {
    std::vector<std::int64_t> lists = own;
    for (const std::int64_t list : own) {
        const auto row =
            connection.Query({"SELECT IDSrcPriceList FROM GRPriceList WHERE ID = ?", {list}});
        const std::int64_t source = row->Next() ? row->GetInteger(0) : 0;
        if (source != 0 && std::find(lists.begin(), lists.end(), source) == lists.end()) {
            lists.push_back(source);
        }
    }
    return lists;
}

std::optional<User> FindUser(CompanyDatabase& database, std::string_view name) {
    return database.pool().Reading(
        [name](Connection& connection) { return FindUser(connection, name); });
}

Reader WithPriceLists(CompanyDatabase& database, const User& user) {
    Reader reader = user.reader;
    const auto lists =
        user.price_list != 0 ? std::vector{user.price_list} : DefaultPriceLists(database);
    reader.price_lists = database.pool().Reading(
        [&lists](Connection& connection) { return WithSourceLists(connection, lists); });
    return reader;
}

}  // namespace

Reader LogOn(CompanyDatabase& database, std::string_view user, std::string_view password) {
    const std::optional<User> found = FindUser(database, user);
    const bool right = IsPassword(password, found ? found->hash : std::string());
    if (!right || found->disabled) {
        FailLogOn();
    }
    return WithPriceLists(database, *found);
}

Reader LogOnOfDatabase(CompanyDatabase& database, std::string_view user) {
    const std::optional<User> found = FindUser(database, user);
    if (!found || found->disabled) {
        FailLogOn();
    }
    return WithPriceLists(database, *found);
}

void FailLogOn() {
    throw base::RuntimeError(base::errors::kLogonFailed, "Unknown user or wrong password");
}

std::vector<std::int64_t> DefaultPriceLists(CompanyDatabase& database) {
    return database.pool().Reading([](Connection& connection) {
        const auto row =
            connection.Query({"SELECT ID FROM GRPriceList WHERE IsDefault = 1 ORDER BY ID", {}});
        std::vector<std::int64_t> lists;
        while (row->Next()) {
            lists.push_back(row->GetInteger(0));
        }
        return lists;
    });
}

}  // namespace zebtell::erp
