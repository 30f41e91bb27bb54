#pragma once

#include <string_view>

#include "erp/access.h"
#include "erp/company_database.h"

namespace zebtell::erp {

// The user's values when the name (in any letter case) and the password are right and he is not
// disabled; RuntimeError kLogonFailed else, after the same time whatever was wrong.
Reader LogOn(CompanyDatabase& database, std::string_view user, std::string_view password);

// The same for a user whose name and password the database itself has taken.
Reader LogOnOfDatabase(CompanyDatabase& database, std::string_view user);

// RuntimeError kLogonFailed, the same whatever was wrong.
[[noreturn]] void FailLogOn();

// The price lists that companies without one of their own use.
std::vector<std::int64_t> DefaultPriceLists(CompanyDatabase& database);

}  // namespace zebtell::erp
