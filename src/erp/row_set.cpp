#include "erp/row_set.h"

#include <algorithm>
#include <iterator>
#include <unordered_map>

namespace zebtell::erp {

std::size_t RowSet::Bytes() const {
    std::size_t bytes = sizeof(RowSet) + values_.size() * sizeof(base::Value);
    for (const base::Value& value : values_) {
        const auto* text = value.As<std::string>();
        bytes += text && text->capacity() > 15 ? text->capacity() + 16 : 0;
    }
    return bytes;
}

void RowSet::Append(const Cursor& cursor) {
    for (std::size_t column = 0; column < fields_->size(); ++column) {
        values_.push_back(cursor.Get(column));
    }
    missing_.push_back(false);
    ++count_;
}

void RowSet::Append(std::vector<base::Value> values) {
    std::move(values.begin(), values.end(), std::back_inserter(values_));
    missing_.push_back(false);
    ++count_;
}

std::shared_ptr<const RowSet> RowSet::Arranged(const RowSet& rows,
                                               std::span<const std::int64_t> keys) {
    std::unordered_map<std::int64_t, std::size_t> row_of;
    for (std::size_t row = 0; row < rows.count(); ++row) {
        row_of.emplace(rows.Get(row, 0).ToInteger64(), row);
    }
    auto arranged = std::make_shared<RowSet>(rows.fields_);
    arranged->values_.reserve(keys.size() * rows.fields_->size());
    for (const std::int64_t key : keys) {
        const auto found = row_of.find(key);
        const bool there = found != row_of.end();
        for (std::size_t field = 0; field < rows.fields_->size(); ++field) {
            arranged->values_.push_back(there ? rows.Get(found->second, field)
                                              : base::Value::Null());
        }
        arranged->missing_.push_back(!there);
        ++arranged->count_;
    }
    return arranged;
}

}  // namespace zebtell::erp
