#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "erp/access.h"
#include "erp/bound_sql.h"
#include "erp/schema.h"
#include "erp/sql/functions.h"

namespace zebtell::erp::sql {

struct Source;

// Tables that paths lead to, in the order of their joins.
struct Joins {
    std::vector<Source*> tables;
};

struct OutputColumn {
    std::string name;
    ValueType type = ValueType::kUnknown;
};

// A table or subquery as it stands in a printed statement.
struct Source {
    enum class Kind { kNamed, kLink, kChild };

    Kind kind = Kind::kNamed;
    std::string alias;                  // in the printed statement: "t1"
    std::string_view name;              // in the text
    const TableInfo* table = nullptr;   // null: a subquery
    const AccessRule* rule = nullptr;   // null: all rows and columns, for the policy's own texts
    std::vector<OutputColumn> columns;  // of a subquery
    Joins* joins = nullptr;             // where the tables go that links lead to from here
    // How a path came here: own_column = parent.parent_column.
    const Source* parent = nullptr;
    std::string_view parent_column;
    std::string_view own_column;
};

// What names mean in one select: its tables, then those of the selects around it.
struct Scope {
    Scope* outer = nullptr;
    std::vector<Source*> sources;
    Joins joins;
    bool links_allowed = true;
};

struct ResolvedColumn {
    const Source* source;
    std::string_view name;  // in the database's letters
    ValueType type;
};

}  // namespace zebtell::erp::sql
