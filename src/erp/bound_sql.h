#pragma once

#include <string>
#include <vector>

#include "base/value.h"

namespace zebtell::erp {

// A statement's text with "?" for each of its values. Lists of IDs are one value: the text
// "[1,2,3]", which both kinds of database take apart.
struct BoundSql {
    std::string text;
    std::vector<base::Value> values;

    friend bool operator==(const BoundSql&, const BoundSql&) = default;
};

enum class Dialect { kSqlite, kSqlServer };

}  // namespace zebtell::erp
