#pragma once

#include <string_view>

namespace zebtell::demo {

// The files of database/sqlite and database/sqlserver, built into the program so that it needs no
// source tree.
extern const std::string_view kSchemaSql;
extern const std::string_view kViewsSql;
extern const std::string_view kServerSchemaSql;
extern const std::string_view kServerLinksSql;
extern const std::string_view kServerViewsSql;

}  // namespace zebtell::demo
