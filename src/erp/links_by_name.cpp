#include "erp/links_by_name.h"

#include <algorithm>
#include <unordered_map>

#include "base/text.h"
#include "erp/needed_tables.h"

namespace zebtell::erp {
namespace {

using Names = std::unordered_map<std::string, std::string, base::NoCaseHash, base::NoCaseEqual>;

// What link columns lead to, by the column's name.
Names LinkTargets(const std::vector<TableInfo>& tables) {
    Names targets;
    for (const TableInfo& table : tables) {
        for (const Column& column : table.columns) {
            if (!column.links_to.empty() && !base::EqualNoCase(column.name, "ID")) {
                targets.try_emplace(column.name, column.links_to);
            }
        }
    }
    for (const TableInfo& table : tables) {
        if (!table.is_view) {
            targets["ID" + table.name] = table.name;
        }
    }
    return targets;
}

TableInfo* Find(std::vector<TableInfo>& tables, std::string_view name) {
    const auto found = std::find_if(tables.begin(), tables.end(), [name](const TableInfo& table) {
        return base::EqualNoCase(table.name, name);
    });
    return found == tables.end() ? nullptr : &*found;
}

void AddKnownLinks(std::vector<TableInfo>& tables) {
    for (const NeededTable& needed : NeededTables()) {
        TableInfo* table = Find(tables, needed.name);
        for (const NeededColumn& known : table ? needed.Columns() : std::vector<NeededColumn>()) {
            const TableInfo* target = Find(tables, known.links_to);
            for (Column& column : table->columns) {
                if (target && column.links_to.empty() &&
                    base::EqualNoCase(column.name, known.name)) {
                    column.links_to = target->name;
                }
            }
        }
    }
}

}  // namespace

void AddLinksByName(std::vector<TableInfo>& tables) {
    AddKnownLinks(tables);
    const Names targets = LinkTargets(tables);
    for (TableInfo& table : tables) {
        for (Column& column : table.columns) {
            const auto found = targets.find(column.name);
            if (column.links_to.empty() && found != targets.end()) {
                column.links_to = found->second;
            }
        }
    }
}

}  // namespace zebtell::erp
