#include "erp/sqlite/catalogue.h"

#include "erp/sqlite/column_types.h"

namespace zebtell::erp::sqlite {
namespace {

TableInfo ReadTable(Connection& connection, std::string name, bool is_view) {
    TableInfo table{std::move(name), is_view, {}};
    const BoundSql sql{
        "SELECT c.name, c.type, f.\"table\" FROM pragma_table_info(?) c "
        "LEFT JOIN pragma_foreign_key_list(?) f ON f.\"from\" = c.name COLLATE NOCASE "
        "ORDER BY c.cid",
        {table.name, table.name}};
    const auto cursor = connection.Query(sql);
    while (cursor->Next()) {
        Column column;
        column.name = cursor->Get(0).ToPlainText();
        column.type = TypeOf(cursor->Get(1).ToPlainText()).value_or(ColumnType::kText);
        column.links_to = cursor->Get(2).ToPlainText();
        table.columns.push_back(std::move(column));
    }
    return table;
}

void ReadLengths(Connection& connection, DatabaseDescription& description) {
    const auto cursor = connection.Query(
        {"SELECT m.name, c.name, c.type FROM sqlite_master m, pragma_table_info(m.name) c "
         "WHERE m.type = 'table'",
         {}});
    while (cursor->Next()) {
        if (const int length = LengthOf(cursor->Get(2).ToPlainText())) {
            const std::string table = cursor->Get(0).ToPlainText();
            description.lengths[table + "." + cursor->Get(1).ToPlainText()] = length;
        }
    }
}

}  // namespace

DatabaseDescription ReadCatalogue(Connection& connection) {
    DatabaseDescription description;
    const auto cursor = connection.Query(
        {"SELECT name, type = 'view' FROM sqlite_master WHERE type IN ('table', 'view') "
         "AND name NOT LIKE 'sqlite%' ORDER BY name",
         {}});
    while (cursor->Next()) {
        description.tables.push_back(
            ReadTable(connection, cursor->Get(0).ToPlainText(), cursor->GetInteger(1) != 0));
    }
    ReadLengths(connection, description);
    return description;
}

}  // namespace zebtell::erp::sqlite
