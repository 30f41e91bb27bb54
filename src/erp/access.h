#pragma once

#include <cstdint>
#include <initializer_list>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::erp {

// Who reads and writes: the roles that the portal logs its users on with.
enum class Role { kUser, kGuest };

// The values that row scopes are made of.
struct Reader {
    Role role = Role::kGuest;
    std::int64_t user = 0;     // SYUser.ID
    std::int64_t partner = 0;  // GRCompany.ID, 0: none
    std::int64_t settlement_company = 0;
    std::int64_t parent = 0;
    std::int64_t employee = 0;                  // the partner's sales employee
    std::int64_t contact = 0;                   // the user's contact person
    std::int64_t price_category = 0;            // the partner's
    std::vector<std::int64_t> price_lists;      // whose lines the reader sees
    std::vector<std::int64_t> saved_documents;  // stored in this session
};

// One row of the access policy: default is no, so a table that has no row can't be read.
struct AccessRule {
    static constexpr std::string_view kNoRows = "no";

    std::string_view table;
    // An SQL condition on the table's own columns; ":partner", ":price_lists" and so on stand for
    // the reader's values. Empty: every row; kNoRows: the table can't be read at all.
    std::string_view user_scope;
    std::string_view guest_scope;
    // Columns that nobody reads through the portal.
    std::vector<std::string_view> hidden_columns = {};
    // Columns that a customer may write (in new documents and in his own unprocessed ones).
    std::vector<std::string_view> writable_columns = {};

    std::string_view Scope(Role role) const {
        return role == Role::kUser ? user_scope : guest_scope;
    }
};

// The whole policy, to be read at a glance.
std::span<const AccessRule> AccessPolicy();

// The rule of a table or view, null when it can't be read at all.
const AccessRule* FindAccessRule(std::string_view table);

}  // namespace zebtell::erp
