#include "tags/field_condition.h"

#include <algorithm>

#include "base/like.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::tags {

namespace {

constexpr std::string_view kOperators = "=#<>";  // in the order in which they are looked for

bool Occurs(const FieldCondition& condition, char operation) {
    return condition.reference.find(operation) != std::string_view::npos;
}

bool EqualOrNot(const FieldCondition& condition, bool equal) {
    return (Occurs(condition, '=') && equal) || (Occurs(condition, '#') && !equal);
}

bool IsList(std::string_view compare) {
    return compare.size() >= 2 && compare.front() == '(' && compare.back() == ')';
}

bool IsListed(std::string_view compare, std::string_view value) {
    const auto items = base::Split(compare.substr(1, compare.size() - 2), ',');
    return std::any_of(items.begin(), items.end(), [&](std::string_view item) {
        return base::EqualNoCase(item, value);
    });
}

double NumberOf(std::string_view text) {
    const auto number = base::ParseNumber(text);
    if (!number) throw base::RuntimeError(base::errors::kTypeMismatch);
    return *number;
}

bool GreaterOrLess(const FieldCondition& condition, std::string_view value) {
    const bool greater = Occurs(condition, '>');
    const bool less = Occurs(condition, '<');
    if (!greater && !less) return false;
    const double number = NumberOf(value);
    const double limit = NumberOf(condition.compare);
    return (greater && number > limit) || (less && number < limit);
}

}  // namespace

std::optional<FieldCondition> ParseCondition(std::string_view reference) {
    const std::size_t semicolon = reference.find(';');
    if (semicolon == std::string_view::npos) return std::nullopt;
    const std::string_view test = reference.substr(0, semicolon);
    for (const char operation : kOperators) {
        const std::size_t at = test.find(operation);
        if (at == std::string_view::npos) continue;
        return FieldCondition{.field = test.substr(0, at),
                              .compare = test.substr(at + 1),
                              .output = reference.substr(semicolon + 1),
                              .reference = reference};
    }
    return std::nullopt;
}

bool Holds(const FieldCondition& condition, std::string_view value) {
    const std::string_view compare = condition.compare;
    if (compare.starts_with('\'')) {
        const std::string pattern = base::Replaced(compare, "'", "");
        return EqualOrNot(condition, base::Like(value, pattern));
    }
    if (IsList(compare)) return EqualOrNot(condition, IsListed(compare, value));
    return EqualOrNot(condition, base::EqualNoCase(value, compare)) ||
           GreaterOrLess(condition, value);
}

}  // namespace zebtell::tags
