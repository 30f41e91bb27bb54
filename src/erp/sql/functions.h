#pragma once

#include <cstddef>
#include <string_view>

#include "erp/bound_sql.h"

namespace zebtell::erp::sql {

enum class ValueType { kUnknown, kInteger, kNumber, kText, kDate };

// A function that texts may call. In its prints "$1" is the first argument, "$*" all of them, and
// "@2" the second argument, which has to be a whole number and is written as such.
struct Function {
    std::string_view name;  // date functions with their part: "dateadd month"
    std::size_t least;      // arguments
    std::size_t most;
    ValueType result;  // kUnknown: that of the first argument
    bool aggregate;
    std::string_view sqlite;
    std::string_view sql_server;

    std::string_view Print(Dialect dialect) const {
        return dialect == Dialect::kSqlite ? sqlite : sql_server;
    }
};

// A type that a value may be turned into; "$1" is the value, "@1" the length or precision, "@2" the
// scale.
struct CastType {
    std::string_view name;
    std::size_t numbers;  // that stand behind the name in parentheses
    ValueType result;
    std::string_view sqlite;
    std::string_view sql_server;

    std::string_view Print(Dialect dialect) const {
        return dialect == Dialect::kSqlite ? sqlite : sql_server;
    }
};

// Names ignore case; null when there is none.
const Function* FindFunction(std::string_view name);
const CastType* FindCastType(std::string_view name, std::size_t numbers);

}  // namespace zebtell::erp::sql
