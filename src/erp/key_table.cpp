#include "erp/key_table.h"

#include <bit>
#include <limits>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kMostRows = 1'000'000;

std::size_t PlaceCount(std::size_t rows) {
    return std::bit_ceil(rows * 2 + 1);
}

std::size_t FirstPlace(std::int64_t number, std::size_t places) {
    const std::uint64_t mixed = static_cast<std::uint64_t>(number) * 0x9E3779B97F4A7C15U;
    return static_cast<std::size_t>(mixed >> 32) & (places - 1);
}

}  // namespace

void CompactKeys::Append(std::int64_t key) {
    const bool fits = key == static_cast<std::int32_t>(key);
    if (wide_.empty() && fits) {
        narrow_.push_back(static_cast<std::int32_t>(key));
        return;
    }
    if (wide_.empty()) {
        wide_.assign(narrow_.begin(), narrow_.end());
        narrow_ = {};
    }
    wide_.push_back(key);
}

std::size_t CompactKeys::Bytes() const {
    return narrow_.capacity() * sizeof(narrow_[0]) + wide_.capacity() * sizeof(wide_[0]);
}

void CompactKeys::ShrinkToFit() {
    narrow_.shrink_to_fit();
    wide_.shrink_to_fit();
}

KeyTable::KeyTable(const std::vector<std::string>& columns) {
    columns_.push_back(std::make_unique<KeyColumn>());
    columns_[0]->name = "ID";
    for (const std::string& column : columns) {
        columns_.push_back(std::make_unique<KeyColumn>());
        columns_.back()->name = column;
    }
}

KeyTable::KeyTable(std::int64_t id) : KeyTable() {
    columns_[0]->keys.Append(id);
}

KeyTable::KeyTable(const KeyTable& from, std::span<const std::uint32_t> rows) {
    for (const auto& column : from.columns_) {
        columns_.push_back(std::make_unique<KeyColumn>());
        columns_.back()->name = column->name;
        CompactKeys& keys = columns_.back()->keys;
        keys.Reserve(rows.size());
        for (const std::uint32_t row : rows) {
            keys.Append(column->keys[row]);
        }
    }
}

KeyTable::KeyTable(Cursor& cursor, const std::vector<std::string>& columns) : KeyTable(columns) {
    while (cursor.Next()) {
        if (count() == kMostRows) {
            throw base::RuntimeError(base::errors::kStatementFailed, "The list is too long");
        }
        for (std::size_t column = 0; column < columns_.size(); ++column) {
            columns_[column]->keys.Append(cursor.GetInteger(column));
        }
    }
    for (const auto& column : columns_) {
        column->keys.ShrinkToFit();
    }
}

std::size_t KeyTable::Bytes() const {
    std::size_t bytes = sizeof(KeyTable);
    for (const auto& column : columns_) {
        bytes += column->keys.Bytes() + PlaceCount(count()) * sizeof(std::uint32_t);
    }
    return bytes;
}

std::optional<std::size_t> KeyTable::ColumnOf(std::string_view name) const {
    for (std::size_t column = 0; column < columns_.size(); ++column) {
        if (base::EqualNoCase(columns_[column]->name, name)) {
            return column;
        }
    }
    return std::nullopt;
}

void KeyTable::Index(const KeyColumn& column) {
    const std::size_t places = PlaceCount(column.keys.size());
    column.places.assign(places, 0);
    for (std::size_t row = 0; row < column.keys.size(); ++row) {
        std::size_t place = FirstPlace(column.keys[row], places);
        while (column.places[place] != 0 &&
               column.keys[column.places[place] - 1] != column.keys[row]) {
            place = (place + 1) & (places - 1);
        }
        if (column.places[place] == 0) {
            column.places[place] = static_cast<std::uint32_t>(row + 1);
        }
    }
}

std::optional<std::size_t> KeyTable::Find(std::size_t column, std::int64_t number) const {
    const KeyColumn& searched = *columns_[column];
    std::call_once(searched.indexed, Index, searched);
    const std::size_t places = searched.places.size();
    std::size_t place = FirstPlace(number, places);
    while (searched.places[place] != 0) {
        const std::size_t row = searched.places[place] - 1;
        if (searched.keys[row] == number) {
            return row;
        }
        place = (place + 1) & (places - 1);
    }
    return std::nullopt;
}

}  // namespace zebtell::erp
