#include "tags/tag_table.h"

#include <stdexcept>

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

TagTable::TagTable(std::initializer_list<TagRow> rows) : rows_(rows) {
    for (std::size_t index = 0; index < rows_.size(); ++index) {
        std::string name = base::LowerAscii(rows_[index].name);
        if (IsPattern(name)) patterns_.emplace_back(name, index);
        if (!exact_.emplace(std::move(name), index).second) {
            throw std::logic_error("tag listed twice: " + std::string(rows_[index].name));
        }
    }
}

const TagRow* TagTable::Find(std::string_view lower_name) const {
    if (const auto found = exact_.find(lower_name); found != exact_.end()) {
        return &rows_[found->second];
    }
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
