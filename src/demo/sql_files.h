#pragma once

#include <string_view>

namespace zebtell::demo {

// database/sqlite/schema.sql and views.sql, built into the program so that it needs no source tree.
extern const std::string_view kSchemaSql;
extern const std::string_view kViewsSql;

}  // namespace zebtell::demo
