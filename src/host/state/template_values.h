#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <unordered_map>

#include "base/text.h"
#include "data/cls_query.h"

namespace zebtell::host {

template <class T>
using NoCaseMap = std::unordered_map<std::string, T, base::NoCaseHash, base::NoCaseEqual>;

// What templates declared and forms left behind, for the tags that follow.
struct TemplateValues {
    NoCaseMap<data::clsQuery> Queries;                  // by page + "::" + name
    std::optional<NoCaseMap<std::string>> SavedValues;  // absent until a form had a saved field
    std::int32_t StoreID = 0;
    std::optional<bool> OrdersAllowed;  // absent: no template has asked yet
    std::string PriceQueryText;
};

}  // namespace zebtell::host
