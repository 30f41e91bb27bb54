#include "web/fields.h"

#include <algorithm>
#include <cstdint>
#include <utility>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::web {

// The fields' numbers in the order of their names in lower case, then of posting. Sorted rather
// than hashed: nobody can post names that all meet in one bucket.
struct FieldList::Index {
    using Entry = std::pair<std::string, std::uint32_t>;

    explicit Index(const std::vector<Field>& fields) {
        entries.reserve(fields.size());
        for (const Field& field : fields) {
            const auto number = static_cast<std::uint32_t>(entries.size());
            entries.emplace_back(base::Lower(field.name), number);
        }
        std::sort(entries.begin(), entries.end());
    }

    std::vector<Entry>::const_iterator First(const std::string& lower_name) const {
        return std::lower_bound(entries.begin(), entries.end(), Entry{lower_name, 0});
    }

    std::vector<Entry> entries;
};

FieldList::FieldList(std::vector<Field> fields)
    : fields_(std::move(fields)),
      index_(fields_.empty() ? nullptr : std::make_shared<const Index>(fields_)) {}

const Field& FieldList::Item(std::size_t index) const {
    if (index < 1 || index > fields_.size()) throw base::RuntimeError(base::errors::kSubscript);
    return fields_[index - 1];
}

bool FieldList::Has(std::string_view name) const {
    if (index_ == nullptr) return false;
    const std::string lower = base::Lower(name);
    const auto first = index_->First(lower);
    return first != index_->entries.end() && first->first == lower;
}

std::string FieldList::operator[](std::string_view name) const {
    std::string values;
    if (index_ == nullptr) return values;
    const std::string lower = base::Lower(name);
    const auto first = index_->First(lower);
    for (auto at = first; at != index_->entries.end() && at->first == lower; ++at) {
        if (at != first) values += ", ";
        values += fields_[at->second].value;
    }
    return values;
}

}  // namespace zebtell::web
