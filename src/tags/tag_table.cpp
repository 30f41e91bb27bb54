#include "tags/tag_table.h"

#include <bit>
#include <stdexcept>

#include "base/name_hash.h"
#include "base/text.h"

namespace zebtell::tags {

namespace {

constexpr char kWildcard = '*';

bool IsPattern(std::string_view name) {
    return name.starts_with(kWildcard) || name.ends_with(kWildcard);
}

bool Matches(std::string_view pattern, std::string_view name) {
    return pattern.front() == kWildcard ? name.ends_with(pattern.substr(1))
                                        : name.starts_with(pattern.substr(0, pattern.size() - 1));
}

}  // namespace

TagTable::TagTable(std::initializer_list<TagRow> rows)
    : rows_(rows), places_(std::bit_ceil(4 * rows.size() + 1)) {
    for (std::size_t index = 0; index < rows_.size(); ++index) {
        lower_names_.push_back(base::LowerAscii(rows_[index].name));
        const std::string& name = lower_names_.back();
        if (IsPattern(name)) patterns_.emplace_back(name, index);
        std::size_t& place = places_[PlaceOf(name)];
        if (place != 0) {
            throw std::logic_error("tag listed twice: " + std::string(rows_[index].name));
        }
        place = index + 1;
    }
}

// Where the name is, or the free place where it would be.
std::size_t TagTable::PlaceOf(std::string_view lower_name) const {
    const std::size_t mask = places_.size() - 1;
    std::size_t place = base::NameHash(lower_name) & mask;
    while (places_[place] != 0 && lower_names_[places_[place] - 1] != lower_name) {
        place = (place + 1) & mask;
    }
    return place;
}

const TagRow* TagTable::Find(std::string_view lower_name) const {
    if (const std::size_t row = places_[PlaceOf(lower_name)]; row != 0) return &rows_[row - 1];
    for (const auto& [pattern, index] : patterns_) {
        if (Matches(pattern, lower_name)) return &rows_[index];
    }
    return nullptr;
}

bool TagTable::Offer(TagCall& call) const {
    const TagRow* row = Find(call.tag.LowerName());
    return row != nullptr && row->function(call);
}

}  // namespace zebtell::tags
