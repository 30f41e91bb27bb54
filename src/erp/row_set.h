#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <vector>

#include "base/value.h"
#include "erp/connection.h"
#include "erp/field_set.h"
#include "erp/result_cache.h"

namespace zebtell::erp {

// Rows of a result in memory.
class RowSet : public Result {
  public:
    explicit RowSet(std::shared_ptr<const FieldSet> fields) : fields_(std::move(fields)) {}

    std::size_t Bytes() const override;

    std::size_t count() const { return count_; }
    const FieldSet& fields() const { return *fields_; }
    const base::Value& Get(std::size_t row, std::size_t field) const {
        return values_[row * fields_->size() + field];
    }
    // Whether the record of that row is there; its values are null when it is not.
    bool Has(std::size_t row) const { return !missing_[row]; }

    bool HasSameValues(const RowSet& other) const { return values_ == other.values_; }

    // The cursor's row as the next row.
    void Append(const Cursor& cursor);
    void Append(std::vector<base::Value> values);  // one a field

    // Rows whose first column is the key, put into the order of `keys`.
    static std::shared_ptr<const RowSet> Arranged(const RowSet& rows,
                                                  std::span<const std::int64_t> keys);

  private:
    std::shared_ptr<const FieldSet> fields_;
    std::size_t count_ = 0;
    std::vector<base::Value> values_;
    std::vector<bool> missing_;
};

}  // namespace zebtell::erp
