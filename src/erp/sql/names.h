#pragma once

#include <memory>
#include <string_view>
#include <vector>

#include "erp/sql/ast.h"
#include "erp/sql/source.h"

namespace zebtell::erp::sql {

// Finds out what the names in one statement mean to its reader, and which tables their paths join.
// The sources that it makes live as long as itself.
class Names {
  public:
    Names(const Schema& schema, Role role) : schema_(schema), role_(role) {}

    // A table that the reader may read; RuntimeError kNoSuchTable for any other.
    Source& Open(std::string_view table);
    // A table in a text of the access policy, which nothing limits.
    Source& OpenUnlimited(std::string_view table);
    Source& OpenSubquery(std::vector<OutputColumn> columns);
    // Makes a source known in a select by a name; RuntimeError when the name is taken.
    void Add(Source& source, std::string_view name, Scope& scope);

    // Aliases of the select and those around it come first, then links, then child tables. Links
    // add their tables to the joins of where they begin, child tables to `children` (null where
    // many rows have no place).
    ResolvedColumn Resolve(const Path& path, Scope& scope, Joins* children);

    static std::vector<ResolvedColumn> ReadableColumns(const Source& source);

  private:
    Source& Make();
    ResolvedColumn Unqualified(std::string_view column, Scope& scope) const;
    Source& Start(std::string_view name, Scope& scope, Joins* children);
    Source& Follow(Source& from, std::string_view step, bool links_allowed, Joins* children);
    Source& FollowLink(Source& from, const Column& link);
    Source* FollowChild(Source& from, std::string_view table, Joins* children);

    const Schema& schema_;
    Role role_;
    std::vector<std::unique_ptr<Source>> sources_;
};

}  // namespace zebtell::erp::sql
