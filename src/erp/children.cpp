#include "erp/children.h"

#include "base/text.h"
#include "erp/keyed_list.h"
#include "erp/sql/errors.h"

namespace zebtell::erp {
namespace {

// The parent's column that leads to a table: the link of the table's name before any other.
const Column* OwnLink(const TableInfo& parent, const TableInfo& table) {
    const Column* named = parent.FindLink(table.name);
    if (named && base::EqualNoCase(named->links_to, table.name)) {
        return named;
    }
    for (const Column& column : parent.columns) {
        if (base::EqualNoCase(column.links_to, table.name)) {
            return &column;
        }
    }
    return nullptr;
}

}  // namespace

std::shared_ptr<data::RecordList> OpenChildren(
    const std::shared_ptr<Session>& session,
    const TableInfo& parent,
    std::int64_t id,
    std::string_view table,
    const std::function<base::Value(const std::string&)>& field) {
    const TableInfo& child = session->database().Table(table);
    if (const Column* link = session->schema().ChildLink(child, parent)) {
        const char* order = child.FindColumn("RowNo") ? "RowNo" : "";
        return OpenKeyedList(session, child, link->name + "=" + std::to_string(id), order);
    }
    const Column* own = OwnLink(parent, child);
    if (!own) {
        sql::Fail("The record has no link to the table", table);
    }
    const base::Value linked = field(own->name);
    const std::int64_t linked_id = linked.IsNull() ? 0 : linked.ToInteger64();
    return OpenKeyedList(session, child, "ID=" + std::to_string(linked_id), "");
}

}  // namespace zebtell::erp
