#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "base/text.h"

namespace zebtell::erp {

// What a column's values become.
enum class ColumnType { kInteger, kDouble, kCurrency, kBoolean, kDateTime, kText };

struct Column {
    std::string name;  // in the database's letters
    ColumnType type = ColumnType::kText;
    // The table that a link column's foreign key leads to (its key ID), "" for other columns.
    std::string links_to;
};

// A table or view as the database describes it. Its key is the column ID.
struct TableInfo {
    std::string name;
    bool is_view = false;
    std::vector<Column> columns;

    // Names ignore case; null when there is no such column.
    const Column* FindColumn(std::string_view column) const;
    // The link column of a link name ("GRTax" is IDGRTax), null when there is none.
    const Column* FindLink(std::string_view link) const;
};

// The database's tables and views, read once per process and then shared by all threads.
class Schema {
  public:
    explicit Schema(std::vector<TableInfo> tables);

    const TableInfo* Find(std::string_view table) const;  // names ignore case; null: none
    // The column of `child` that links to `parent`, or to a table whose key `parent` shares (an
    // SDOrder is a GDocument: its ID is the document's); null when there is none.
    const Column* ChildLink(const TableInfo& child, const TableInfo& parent) const;
    const std::vector<TableInfo>& tables() const { return tables_; }

  private:
    std::vector<TableInfo> tables_;
    std::unordered_map<std::string, std::size_t, base::NoCaseHash, base::NoCaseEqual> by_name_;
};

}  // namespace zebtell::erp
