#include "erp/sql/narrow.h"

#include <algorithm>

#include "base/text.h"

namespace zebtell::erp::sql {
namespace {

// What has to hold for a condition to hold.
std::vector<const Expr*> Conjuncts(const ExprPtr& condition) {
    std::vector<const Expr*> conjuncts;
    const auto* logic = condition ? std::get_if<Logic>(&condition->node) : nullptr;
    if (logic && logic->is_and) {
        for (const ExprPtr& operand : logic->operands) {
            conjuncts.push_back(operand.get());
        }
    } else if (condition) {
        conjuncts.push_back(condition.get());
    }
    return conjuncts;
}

bool SamePath(const Path& a, const Path& b) {
    return std::equal(
        a.parts.begin(), a.parts.end(), b.parts.begin(), b.parts.end(), base::EqualNoCase);
}

// Of a subquery of plain rows, whose every column is a column of its tables: the one by that name.
const Path* OutputPath(const Select& subquery, std::string_view name) {
    const Path* found = nullptr;
    for (const Item& item : subquery.items) {
        const auto* path = item.star ? nullptr : std::get_if<Path>(&item.expression->node);
        if (!path) {
            return nullptr;
        }
        if (base::EqualNoCase(item.alias.empty() ? path->parts.back() : item.alias, name)) {
            found = path;
        }
    }
    return found;
}

bool IsPlain(const Select& subquery) {
    return !subquery.top && !subquery.distinct && subquery.group.empty() && !subquery.having;
}

// The column of the subquery that the join makes equal to `column`.
const Path* JoinedTo(const Path& column, const TableRef& table) {
    for (const Expr* conjunct : Conjuncts(table.on)) {
        const auto* equal = std::get_if<Comparison>(&conjunct->node);
        const auto* left = equal ? std::get_if<Path>(&equal->left->node) : nullptr;
        const auto* right = equal ? std::get_if<Path>(&equal->right->node) : nullptr;
        if (!left || !right || equal->operation != "=") {
            continue;
        }
        const Path& other = SamePath(*left, column) ? *right : *left;
        if ((SamePath(*left, column) || SamePath(*right, column)) && other.parts.size() == 2 &&
            base::EqualNoCase(other.parts[0], table.alias)) {
            return OutputPath(*table.subquery, other.parts[1]);
        }
    }
    return nullptr;
}

void AddCondition(Select& select, const Path& column, const std::string& integers) {
    auto path = std::make_unique<Expr>(Expr{column});
    auto in = std::make_unique<Expr>(Expr{In{false, std::move(path), integers}});
    if (!select.where) {
        select.where = std::move(in);
        return;
    }
    Logic both;
    both.operands.push_back(std::move(select.where));
    both.operands.push_back(std::move(in));
    select.where = std::make_unique<Expr>(Expr{std::move(both)});
}

}  // namespace

void NarrowSubqueries(Select& select) {
    for (const Expr* conjunct : Conjuncts(select.where)) {
        const auto* in = std::get_if<In>(&conjunct->node);
        const auto* column = in ? std::get_if<Path>(&in->operand->node) : nullptr;
        const auto* integers = in ? std::get_if<std::string>(&in->set) : nullptr;
        if (!column || !integers || in->negated) {
            continue;
        }
        for (TableRef& table : select.from) {
            if (!table.subquery || !table.on || !IsPlain(*table.subquery)) {
                continue;
            }
            if (const Path* inner = JoinedTo(*column, table)) {
                AddCondition(*table.subquery, *inner, *integers);
            }
        }
    }
}

}  // namespace zebtell::erp::sql
