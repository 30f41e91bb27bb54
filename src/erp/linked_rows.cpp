#include "erp/linked_rows.h"

namespace zebtell::erp {

base::Value LinkedRows::Get(const TableInfo& table,
                            std::int64_t id,
                            std::string_view path,
                            const Keys& others) {
    Known& known = tables_[table.name];
    if (!known.row_of.contains(id) || !known.rows->fields().Find(path)) {
        Read(known, table, id, path, others);
    }
    const auto field = known.rows->fields().Find(path);
    return field ? known.rows->Get(known.row_of.at(id), *field) : base::Value::Null();
}

void LinkedRows::Read(Known& known,
                      const TableInfo& table,
                      std::int64_t id,
                      std::string_view path,
                      const Keys& others) {
    std::unordered_map<std::int64_t, std::size_t> row_of{{id, 0}};
    std::vector<std::int64_t> ids{id};
    for (const std::int64_t other : others()) {
        if (row_of.try_emplace(other, ids.size()).second) {
            ids.push_back(other);
        }
    }
    known.rows = session_->Rows(table, ids, path);
    known.row_of = std::move(row_of);
}

}  // namespace zebtell::erp
