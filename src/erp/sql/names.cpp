#include "erp/sql/names.h"

#include <algorithm>

#include "base/text.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::sql {
namespace {

constexpr std::size_t kMostSources = 60;  // SQLite joins at most 64 tables
constexpr std::size_t kMostSteps = 10;

ValueType TypeOf(ColumnType type) {
    switch (type) {
        case ColumnType::kText:
            return ValueType::kText;
        case ColumnType::kDateTime:
            return ValueType::kDate;
        default:
            return ValueType::kNumber;
    }
}

bool IsHidden(const Source& source, std::string_view column) {
    if (!source.rule) {
        return false;
    }
    const auto& hidden = source.rule->hidden_columns;
    return std::any_of(hidden.begin(), hidden.end(), [column](std::string_view name) {
        return base::EqualNoCase(name, column);
    });
}

std::optional<ResolvedColumn> Find(const Source& source, std::string_view column) {
    if (source.table) {
        const Column* found = source.table->FindColumn(column);
        if (!found || IsHidden(source, column)) {
            return std::nullopt;
        }
        return ResolvedColumn{&source, found->name, TypeOf(found->type)};
    }
    std::optional<ResolvedColumn> result;
    for (const OutputColumn& output : source.columns) {
        if (base::EqualNoCase(output.name, column)) {
            if (result) {
                Fail("Ambiguous column", column);
            }
            result = ResolvedColumn{&source, output.name, output.type};
        }
    }
    return result;
}

// The one link column that leads to a table, null when there is none.
const Column* OnlyLinkTo(const TableInfo& from, std::string_view table) {
    const Column* link = nullptr;
    for (const Column& column : from.columns) {
        if (base::EqualNoCase(column.links_to, table) && !base::EqualNoCase(column.name, "ID")) {
            if (link) {
                Fail("Ambiguous link", table);
            }
            link = &column;
        }
    }
    return link;
}

// By the link's name, else by that of the table that it leads to.
const Column* FindLink(const Source& source, std::string_view name) {
    if (!source.table) {
        return nullptr;
    }
    const Column* named = source.table->FindLink(name);
    const Column* link = named ? named : OnlyLinkTo(*source.table, name);
    return link && !IsHidden(source, link->name) ? link : nullptr;
}

}  // namespace

Source& Names::Make() {
    if (sources_.size() == kMostSources) {
        Fail("The condition or statement reads too many tables");
    }
    sources_.push_back(std::make_unique<Source>());
    Source& source = *sources_.back();
    source.alias = "t" + std::to_string(sources_.size());
    return source;
}

Source& Names::Open(std::string_view table) {
    const AccessRule* rule = FindAccessRule(table);
    if (!rule || rule->Scope(role_) == AccessRule::kNoRows) {
        FailNoTable(table);
    }
    Source& source = OpenUnlimited(table);
    source.rule = rule;
    return source;
}

Source& Names::OpenUnlimited(std::string_view table) {
    const TableInfo* found = schema_.Find(table);
    if (!found) {
        FailNoTable(table);
    }
    Source& source = Make();
    source.table = found;
    return source;
}

Source& Names::OpenSubquery(std::vector<OutputColumn> columns) {
    Source& source = Make();
    source.columns = std::move(columns);
    return source;
}

void Names::Add(Source& source, std::string_view name, Scope& scope) {
    for (const Source* other : scope.sources) {
        if (base::EqualNoCase(other->name, name)) {
            Fail("Two tables of one name", name);
        }
    }
    source.name = name;
    source.joins = &scope.joins;
    scope.sources.push_back(&source);
}

ResolvedColumn Names::Resolve(const Path& path, Scope& scope, Joins* children) {
    const auto& parts = path.parts;
    if (parts.size() == 1) {
        return Unqualified(parts.front(), scope);
    }
    if (parts.size() > kMostSteps) {
        Fail("A path of too many steps", parts.front());
    }
    Source* source = &Start(parts.front(), scope, children);
    for (std::size_t i = 1; i + 1 < parts.size(); ++i) {
        source = &Follow(*source, parts[i], scope.links_allowed, children);
    }
    if (const auto column = Find(*source, parts.back())) {
        return *column;
    }
    Fail("No such column", std::string(parts[parts.size() - 2]) + "." + std::string(parts.back()));
}

ResolvedColumn Names::Unqualified(std::string_view column, Scope& scope) const {
    for (const Scope* level = &scope; level; level = level->outer) {
        std::optional<ResolvedColumn> found;
        for (const Source* source : level->sources) {
            if (const auto here = Find(*source, column)) {
                if (found) {
                    Fail("Ambiguous column", column);
                }
                found = here;
            }
        }
        if (found) {
            return *found;
        }
    }
    Fail("No such column", column);
}

Source& Names::Start(std::string_view name, Scope& scope, Joins* children) {
    for (const Scope* level = &scope; level; level = level->outer) {
        for (Source* source : level->sources) {
            if (base::EqualNoCase(source->name, name)) {
                return *source;
            }
        }
    }
    for (const Scope* level = &scope; level; level = level->outer) {
        Source* from = nullptr;
        for (Source* source : level->sources) {
            if (FindLink(*source, name)) {
                if (from) {
                    Fail("Ambiguous link", name);
                }
                from = source;
            }
        }
        if (from) {
            return Follow(*from, name, level->links_allowed, children);
        }
    }
    for (const Scope* level = &scope; level; level = level->outer) {
        for (Source* source : level->sources) {
            if (Source* child = FollowChild(*source, name, children)) {
                return *child;
            }
        }
    }
    Fail("No such table or link here", name);
}

Source& Names::Follow(Source& from, std::string_view step, bool links_allowed, Joins* children) {
    if (const Column* link = FindLink(from, step)) {
        if (!links_allowed) {
            Fail("A link has no place in a join's condition", step);
        }
        return FollowLink(from, *link);
    }
    if (Source* child = FollowChild(from, step, children)) {
        return *child;
    }
    Fail("No such link", step);
}

Source& Names::FollowLink(Source& from, const Column& link) {
    for (Source* joined : from.joins->tables) {
        if (joined->parent == &from && joined->parent_column == link.name) {
            return *joined;
        }
    }
    Source& source = Open(link.links_to);
    source.kind = Source::Kind::kLink;
    source.joins = from.joins;
    source.parent = &from;
    source.parent_column = link.name;
    source.own_column = "ID";
    from.joins->tables.push_back(&source);
    return source;
}

// Null when there is no child table of that name.
Source* Names::FollowChild(Source& from, std::string_view table, Joins* children) {
    const TableInfo* child = from.table ? schema_.Find(table) : nullptr;
    const Column* link = child ? schema_.ChildLink(*child, *from.table) : nullptr;
    if (!link) {
        return nullptr;
    }
    if (!children) {
        Fail("A path through a child table has no place here", table);
    }
    for (Source* joined : children->tables) {
        if (joined->parent == &from && joined->table == child) {
            return joined;
        }
    }
    Source& source = Open(table);
    source.kind = Source::Kind::kChild;
    source.joins = children;
    source.parent = &from;
    source.parent_column = "ID";
    source.own_column = link->name;
    children->tables.push_back(&source);
    return &source;
}

std::vector<ResolvedColumn> Names::ReadableColumns(const Source& source) {
    std::vector<ResolvedColumn> columns;
    if (!source.table) {
        for (const OutputColumn& output : source.columns) {
            columns.push_back({&source, output.name, output.type});
        }
        return columns;
    }
    for (const Column& column : source.table->columns) {
        if (!IsHidden(source, column.name)) {
            columns.push_back({&source, column.name, TypeOf(column.type)});
        }
    }
    return columns;
}

}  // namespace zebtell::erp::sql
