#include "erp/view_links.h"

#include <unordered_map>

#include "base/text.h"

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

}  // namespace

void FindViewLinks(std::vector<TableInfo>& tables) {
    const Names targets = LinkTargets(tables);
    for (TableInfo& table : tables) {
        for (Column& column : table.columns) {
            const auto found = targets.find(column.name);
            if (table.is_view && column.links_to.empty() && found != targets.end()) {
                column.links_to = found->second;
            }
        }
    }
}

}  // namespace zebtell::erp
