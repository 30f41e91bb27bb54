#include "erp/schema.h"

namespace zebtell::erp {
const Column* TableInfo::FindColumn(std::string_view column) const {
    for (const Column& known : columns) {
        if (known.name.size() == column.size() && base::EqualNoCase(known.name, column)) {
            return &known;
        }
    }
    return nullptr;
}

const Column* TableInfo::FindLink(std::string_view link) const {
    for (const Column& known : columns) {
        const std::string_view name = known.name;
        if (!known.links_to.empty() && name.size() == link.size() + 2 &&
            base::EqualNoCase(name.substr(0, 2), "ID") && base::EqualNoCase(name.substr(2), link)) {
            return &known;
        }
    }
    return nullptr;
}

Schema::Schema(std::vector<TableInfo> tables) : tables_(std::move(tables)) {
    for (std::size_t i = 0; i < tables_.size(); ++i) {
        by_name_.emplace(tables_[i].name, i);
    }
}

const TableInfo* Schema::Find(std::string_view table) const {
    const auto found = by_name_.find(table);
    return found == by_name_.end() ? nullptr : &tables_[found->second];
}

const Column* Schema::ChildLink(const TableInfo& child, const TableInfo& parent) const {
    const Column* parent_key = parent.FindColumn("ID");
    const std::string_view shared = parent_key ? std::string_view(parent_key->links_to) : "";
    const Column* best = nullptr;
    int best_rank = 0;
    for (const Column& column : child.columns) {
        const bool direct = base::EqualNoCase(column.links_to, parent.name);
        if (column.links_to.empty() || (!direct && !base::EqualNoCase(column.links_to, shared))) {
            continue;
        }
        const bool named_alike = base::EqualNoCase(column.name, "ID" + column.links_to);
        const int rank = (direct ? 2 : 0) + (named_alike ? 2 : 1);
        if (rank > best_rank) {
            best = &column;
            best_rank = rank;
        }
    }
    return best;
}

}  // namespace zebtell::erp
