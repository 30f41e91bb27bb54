#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "base/ignore_errors.h"
#include "demo/connection_store.h"
#include "erp/connection.h"
#include "erp/sqlite/backend.h"

namespace zebtell::erp {

inline demo::Cell CellOf(const base::Value& value) {
    switch (value.kind()) {
        case base::Value::Kind::kBoolean:
        case base::Value::Kind::kInteger:
            return value.ToInteger64();
        case base::Value::Kind::kDouble:
            return *value.As<double>();
        case base::Value::Kind::kCurrency:
            return *value.As<base::Currency>();
        case base::Value::Kind::kDateTime:
            return *value.As<base::DateTime>();
        case base::Value::Kind::kText:
            return std::string_view(value.text());
        default:
            return {};
    }
}

inline void CopyTable(Connection& from, const TableInfo& table, demo::ConnectionStore& to) {
    const std::vector<std::string_view> columns = [&table] {
        std::vector<std::string_view> names;
        for (const Column& column : table.columns) {
            names.push_back(column.name);
        }
        return names;
    }();
    demo::RowWriter& writer = to.Table(table.name, columns);
    const auto rows = from.Query({"SELECT * FROM " + table.name, {}});
    while (rows->Next()) {
        std::vector<base::Value> values;
        for (std::size_t i = 0; i < columns.size(); ++i) {
            values.push_back(rows->Get(i));
        }
        std::vector<demo::Cell> cells;
        for (const base::Value& value : values) {
            cells.push_back(CellOf(value));
        }
        writer.Write(cells);
    }
}

// Fills an empty database of a server with the rows of a SQLite company.
inline void CopyCompany(const std::filesystem::path& file, Backend& server) {
    const auto from = sqlite::SqliteBackend(file.string()).Connect(Access::kRead);
    demo::ConnectionStore to(server);
    for (const TableInfo& table : from->Describe().tables) {
        if (!table.is_view) {
            CopyTable(*from, table, to);
        }
    }
    to.Finish();
}

// Drops the portal's tables and views, with all that is in them. What others link to can't go
// before them, so it takes some rounds.
inline void DropCompany(Backend& server) {
    const auto connection = server.Connect(Access::kWrite);
    for (int round = 0; round < 20; ++round) {
        const auto tables = connection->Describe().tables;
        if (tables.empty()) {
            return;
        }
        for (const TableInfo& table : tables) {
            const std::string kind = table.is_view ? "VIEW " : "TABLE ";
            base::IgnoreErrors([&] { connection->Execute({"DROP " + kind + table.name, {}}); });
        }
    }
}

}  // namespace zebtell::erp
