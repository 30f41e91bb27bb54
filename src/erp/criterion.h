#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace zebtell::erp {

// What Find looks for: "field=whole number".
struct Criterion {
    std::string field;
    std::int64_t number = 0;
};

// RuntimeError 5 for any other text.
Criterion ParseCriterion(std::string_view text);

}  // namespace zebtell::erp
