#include "erp/field_set.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kMostFields = 100;

}  // namespace

FieldSet::FieldSet(std::vector<std::string> names) : names_(std::move(names)) {
    for (std::size_t i = 0; i < names_.size(); ++i) {
        by_name_.try_emplace(names_[i], i);
    }
}

std::optional<std::size_t> FieldSet::Find(std::string_view name) const {
    const auto found = by_name_.find(name);
    return found == by_name_.end() ? std::nullopt : std::optional(found->second);
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
