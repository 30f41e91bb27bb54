#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "erp/connection.h"
#include "erp/result_cache.h"

namespace zebtell::erp {

// Keys in as few bytes as they need: four each until one is larger than that.
class CompactKeys {
  public:
    void Append(std::int64_t key);
    void Reserve(std::size_t count) { narrow_.reserve(count); }
    std::int64_t operator[](std::size_t i) const {
        return wide_.empty() ? std::int64_t{narrow_[i]} : wide_[i];
    }
    std::size_t size() const { return wide_.empty() ? narrow_.size() : wide_.size(); }
    std::size_t Bytes() const;
    void ShrinkToFit();

  private:
    std::vector<std::int32_t> narrow_;
    std::vector<std::int64_t> wide_;
};

// The keys of a list in its order, and beside each the numbers of some columns that records are
// looked up by. Shared by the sessions that opened the same list.
class KeyTable : public Result {
  public:
    // The cursor's columns: the key, then `columns`. RuntimeError kStatementFailed when there are
    // more rows than a list may have.
    KeyTable(Cursor& cursor, const std::vector<std::string>& columns);
    KeyTable() : KeyTable(std::vector<std::string>()) {}  // no rows
    explicit KeyTable(std::int64_t id);                   // one row
    // The rows of another table in another order.
    KeyTable(const KeyTable& from, std::span<const std::uint32_t> rows);

    std::size_t Bytes() const override;

    std::size_t count() const { return ids().size(); }
    const CompactKeys& ids() const { return columns_[0]->keys; }
    // The place of a column's numbers here: 0 for "ID"; nothing for a column that is not here.
    std::optional<std::size_t> ColumnOf(std::string_view name) const;
    std::int64_t Get(std::size_t row, std::size_t column) const {
        return columns_[column]->keys[row];
    }
    // The first row with that number in the column.
    std::optional<std::size_t> Find(std::size_t column, std::int64_t number) const;

  private:
    struct KeyColumn {
        std::string name;
        CompactKeys keys;
        // Open addressing: rows plus 1, 0 for free places. Made when something is first looked up.
        mutable std::once_flag indexed;
        mutable std::vector<std::uint32_t> places;
    };

    explicit KeyTable(const std::vector<std::string>& columns);
    static void Index(const KeyColumn& column);

    std::vector<std::unique_ptr<KeyColumn>> columns_;
};

}  // namespace zebtell::erp
