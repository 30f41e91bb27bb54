#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "base/text.h"
#include "base/value.h"
#include "erp/schema.h"
#include "erp/session.h"

namespace zebtell::erp {

// A record's values in memory: its table's columns, and the "@" fields that pages keep with it.
class RecordFields {
  public:
    // Texts are empty, all else is null.
    explicit RecordFields(const TableInfo& table);

    const TableInfo& table() const { return *table_; }

    // Of a column that may be read or an "@" field (empty until it is set); null for other names.
    const base::Value* Find(std::string_view name) const;
    // Of a column that the table has.
    const base::Value& Get(std::string_view column) const;
    base::Currency Money(std::string_view column) const;  // null: 0
    double Number(std::string_view column) const;         // null: 0
    std::int64_t Integer(std::string_view column) const;  // null: 0

    void Set(std::string_view name, base::Value value);  // a column of the table, or an "@" field

    // The row of a result whose columns are named as the table's.
    void Take(const RowSet& rows, std::size_t row);

  private:
    std::size_t IndexOf(std::string_view column) const;

    const TableInfo* table_;  // the schema's
    std::vector<base::Value> values_;
    std::unordered_map<std::string, base::Value, base::NoCaseHash, base::NoCaseEqual> extras_;
};

// The column when the reader may write it; RuntimeError 5 else, kStatementFailed when there is no
// such column.
const Column& WritableColumn(const TableInfo& table, std::string_view name);

// `value` as the column takes it. RuntimeError 13 for what does not convert, 5 for text that is too
// long, for amounts and numbers out of range, and for a link to a record that the reader can't see.
base::Value Accepted(Session& session,
                     const TableInfo& table,
                     const Column& column,
                     const base::Value& value);

}  // namespace zebtell::erp
