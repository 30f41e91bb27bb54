#pragma once

#include <string>
#include <string_view>

namespace zebtell::erp::odbc {

// "Server=...;Database=..." as it is; a name alone is a data source's: "DSN=name".
std::string ConnectionString(std::string_view path);

// Whether it says by itself who logs on: a user, or the operating system's.
bool HasLogin(std::string_view connection_string);

// Whatever the name and password hold, they stay values.
std::string WithLogin(std::string_view connection_string,
                      std::string_view user,
                      std::string_view password);

}  // namespace zebtell::erp::odbc
