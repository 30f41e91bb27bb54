#include "erp/write_sql.h"

namespace zebtell::erp {
namespace {

base::Value Stored(const base::Value& value) {
    return value.IsBlank() ? base::Value::Null() : value;
}

}  // namespace

BoundSql InsertSql(std::string_view table, const ColumnValues& values) {
    BoundSql sql;
    std::string marks;
    sql.text = "INSERT INTO " + std::string(table) + " (";
    for (const auto& [column, value] : values) {
        sql.text += (marks.empty() ? "" : ", ") + column;
        marks += marks.empty() ? "?" : ", ?";
        sql.values.push_back(Stored(value));
    }
    sql.text += ") VALUES (" + marks + ")";
    return sql;
}

BoundSql UpdateSql(std::string_view table, std::int64_t id, const ColumnValues& values) {
    BoundSql sql;
    sql.text = "UPDATE " + std::string(table) + " SET ";
    for (const auto& [column, value] : values) {
        sql.text += (sql.values.empty() ? "" : ", ") + column + " = ?";
        sql.values.push_back(Stored(value));
    }
    sql.text += " WHERE ID = ?";
    sql.values.emplace_back(id);
    return sql;
}

std::string_view KeptUntilCommit(Dialect dialect) {
    // SQLite lets nobody else write behind the beginning of a write transaction.
    return dialect == Dialect::kSqlite ? "" : " WITH (UPDLOCK, HOLDLOCK)";
}

}  // namespace zebtell::erp
