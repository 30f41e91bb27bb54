#pragma once

#include <chrono>
#include <memory>
#include <string_view>

#include "erp/key_table.h"
#include "erp/read_only_record.h"
#include "erp/row_set.h"
#include "erp/session.h"

namespace zebtell::erp {

// The rows of a list of keys, read in windows. Shared by the list and its records.
class KeyedRows {
  public:
    struct Row {
        std::shared_ptr<const RowSet> rows;
        std::size_t row = 0;
    };

    KeyedRows(std::shared_ptr<Session> session,
              const TableInfo& table,
              std::shared_ptr<const KeyTable> keys)
        : session_(std::move(session)), table_(table), keys_(std::move(keys)) {}

    Session& session() const { return *session_; }
    const std::shared_ptr<Session>& shared_session() const { return session_; }
    const TableInfo& table() const { return table_; }
    const KeyTable& keys() const { return *keys_; }

    // The row of a key, position from 0, with `field` when one is named.
    Row Fetch(std::size_t position, std::string_view field = {});

  private:
    bool InWindow(std::size_t position) const;
    bool IsFresh();
    void MoveWindow(std::size_t position);
    void ReadWindow(std::string_view field);

    std::shared_ptr<Session> session_;
    const TableInfo& table_;  // the schema's, which the session keeps
    std::shared_ptr<const KeyTable> keys_;

    std::size_t first_ = 0;
    std::size_t length_ = 0;
    std::shared_ptr<const RowSet> window_;
    std::int64_t version_ = 0;  // the database's when the window was read
    std::chrono::steady_clock::time_point looked_;
};

// A table's or view's records that a filter gave.
class KeyedList : public ReadOnlyList {
  public:
    KeyedList(std::shared_ptr<KeyedRows> rows, data::Filter filter, std::string order)
        : rows_(std::move(rows)), filter_(std::move(filter)), order_(std::move(order)) {}

    std::int64_t Count() override;
    std::shared_ptr<data::Record> Item(std::int64_t index) override;
    std::shared_ptr<data::Record> Find(std::string_view criterion) override;

  private:
    std::optional<std::size_t> Position(std::string_view field, std::int64_t number);

    std::shared_ptr<KeyedRows> rows_;
    data::Filter filter_;
    std::string order_;
    std::shared_ptr<const KeyTable> find_keys_;  // read again with a column that was missing
};

std::shared_ptr<data::RecordList> OpenKeyedList(const std::shared_ptr<Session>& session,
                                                const TableInfo& table,
                                                const data::Filter& filter,
                                                std::string_view order);

// The record of that key, none when the reader sees none.
std::shared_ptr<data::Record> LoadRecord(const std::shared_ptr<Session>& session,
                                         const TableInfo& table,
                                         std::int64_t id);

}  // namespace zebtell::erp
