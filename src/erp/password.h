#pragma once

#include <string>
#include <string_view>

namespace zebtell::erp {

// The argon2id hash of a password, salt and cost included, as SYUser.PasswordHash keeps it. Takes
// some 20 ms of processor time and 19 MiB on purpose; no more of them run at a time than the
// machine has cores.
std::string HashPassword(std::string_view password);

// Whether the hash is of this password. An empty hash (an unknown user) takes as long as any and
// is never right.
bool IsPassword(std::string_view password, const std::string& hash);

}  // namespace zebtell::erp
