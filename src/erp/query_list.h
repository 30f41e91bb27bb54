#pragma once

#include <memory>
#include <optional>
#include <string>
#include <unordered_map>

#include "erp/linked_rows.h"
#include "erp/read_only_record.h"
#include "erp/session.h"

namespace zebtell::erp {

// A select statement's result. Its columns IDX are links where the schema knows a table for them.
class QueryRows {
  public:
    QueryRows(const std::shared_ptr<Session>& session,
              std::shared_ptr<const RowSet> rows,
              const TableInfo* table)
        : session_(session), rows_(std::move(rows)), table_(table), linked_(session) {}

    const std::shared_ptr<Session>& session() const { return session_; }
    const RowSet& rows() const { return *rows_; }
    // The table that the statement selects from; null when that is not plain.
    const TableInfo* table() const { return table_; }

    // The field behind a link of a row.
    base::Value Linked(std::size_t row, std::string_view link, std::string_view path);

  private:
    std::shared_ptr<Session> session_;
    std::shared_ptr<const RowSet> rows_;
    const TableInfo* table_;
    LinkedRows linked_;
};

class QueryList : public ReadOnlyList {
  public:
    explicit QueryList(std::shared_ptr<QueryRows> rows) : rows_(std::move(rows)) {}

    std::int64_t Count() override;
    std::shared_ptr<data::Record> Item(std::int64_t index) override;
    std::shared_ptr<data::Record> Find(std::string_view criterion) override;

  private:
    using Index = std::unordered_map<std::int64_t, std::size_t>;

    const Index& IndexOf(std::size_t field);

    std::shared_ptr<QueryRows> rows_;
    std::unordered_map<std::size_t, Index> indexes_;  // of the fields that were looked up by
};

std::shared_ptr<data::RecordList> OpenQueryList(const std::shared_ptr<Session>& session,
                                                std::string_view sql);

}  // namespace zebtell::erp
