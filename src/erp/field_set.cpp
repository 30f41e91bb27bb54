#include "erp/field_set.h"

#include <bit>

#include "base/name_hash.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kMostFields = 100;

}  // namespace

FieldSet::FieldSet(std::vector<std::string> names)
    : names_(std::move(names)), places_(std::bit_ceil(4 * names_.size() + 1)) {
    for (std::size_t i = 0; i < names_.size(); ++i) {
        std::uint32_t& place = places_[PlaceOf(names_[i])];
        if (place == 0) {
            place = static_cast<std::uint32_t>(i + 1);
        }
    }
}

std::optional<std::size_t> FieldSet::Find(std::string_view name) const {
    const std::uint32_t place = places_[PlaceOf(name)];
    return place == 0 ? std::nullopt : std::optional<std::size_t>(place - 1);
}

// Where the name is, or the free place where it would be.
std::size_t FieldSet::PlaceOf(std::string_view name) const {
    std::size_t place = base::NameHash(name) & (places_.size() - 1);
    while (places_[place] != 0) {
        const std::string& known = names_[places_[place] - 1];
        if (known == name || base::EqualNoCase(known, name)) {
            break;
        }
        place = (place + 1) & (places_.size() - 1);
    }
    return place;
}

std::shared_ptr<const FieldSet> LearnedFields::Known(const std::string& table) const {
    std::lock_guard lock(mutex_);
    const auto found = tables_.find(table);
    return found == tables_.end() ? nullptr : found->second;
}

std::shared_ptr<const FieldSet> LearnedFields::Start(const std::string& table,
                                                     std::vector<std::string> own) {
    std::vector<std::string> names{"ID"};
    for (std::string& name : own) {
        if (!base::EqualNoCase(name, "ID")) {
            names.push_back(std::move(name));
        }
    }
    auto fields = std::make_shared<const FieldSet>(std::move(names));
    std::lock_guard lock(mutex_);
    return tables_.try_emplace(table, std::move(fields)).first->second;
}

void LearnedFields::Learn(const std::string& table, std::shared_ptr<const FieldSet> fields) {
    std::lock_guard lock(mutex_);
    auto& known = tables_[table];
    if (fields->size() <= kMostFields && (!known || known->size() < fields->size())) {
        known = std::move(fields);
    }
}

}  // namespace zebtell::erp
