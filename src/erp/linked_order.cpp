#include "erp/linked_order.h"

#include "base/text.h"
#include "erp/sql/parser.h"

namespace zebtell::erp {

std::optional<LinkedOrder> FindLinkedOrder(const Schema& schema,
                                           const TableInfo& table,
                                           std::string_view order) {
    if (base::Trimmed(order).empty()) {
        return std::nullopt;
    }
    const auto items = sql::Parser(order, sql::Style::kFilter).ParseOrderList();
    const auto* path =
        items.size() == 1 ? std::get_if<sql::Path>(&items[0].expression->node) : nullptr;
    const Column* link = path && path->parts.size() == 2 ? table.FindLink(path->parts[0]) : nullptr;
    const TableInfo* target = link ? schema.Find(link->links_to) : nullptr;
    if (!target) {
        return std::nullopt;
    }
    const bool descending = items[0].descending;
    return LinkedOrder{
        link, target, std::string(path->parts[1]) + (descending ? " desc" : ""), descending};
}

std::shared_ptr<const KeyTable> ArrangedByLink(const KeyTable& list,
                                               std::size_t link,
                                               const KeyTable& linked,
                                               bool descending) {
    const std::size_t none = descending ? linked.count() : 0;
    const std::size_t shift = descending ? 0 : 1;
    std::vector<std::uint32_t> places(list.count());
    std::vector<std::uint32_t> next(linked.count() + 2);  // by place: how many stand before it
    for (std::size_t row = 0; row < list.count(); ++row) {
        const auto found = linked.Find(0, list.Get(row, link));
        places[row] = static_cast<std::uint32_t>(found ? *found + shift : none);
        ++next[places[row] + 1];
    }
    for (std::size_t place = 1; place < next.size(); ++place) {
        next[place] += next[place - 1];
    }
    std::vector<std::uint32_t> rows(list.count());
    for (std::size_t row = 0; row < list.count(); ++row) {
        rows[next[places[row]]++] = static_cast<std::uint32_t>(row);
    }
    return std::make_shared<const KeyTable>(list, rows);
}

}  // namespace zebtell::erp
