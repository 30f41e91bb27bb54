#pragma once

#include <span>
#include <string_view>
#include <vector>

namespace zebtell::erp {

struct NeededColumn {
    std::string_view name;
    std::string_view links_to;  // the table of whose rows it holds keys, "" for other columns
};

// A table or view that the portal reads or writes, with the columns that it and its default
// templates name.
struct NeededTable {
    std::string_view name;
    std::string_view
        columns;  // separated by blanks, links as "IDParent>GRCompany", most without ID

    std::vector<NeededColumn> Columns() const;  // with ID
};

std::span<const NeededTable> NeededTables();

}  // namespace zebtell::erp
