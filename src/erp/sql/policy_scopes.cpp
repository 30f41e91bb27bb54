#include "erp/sql/policy_scopes.h"

#include <unordered_map>

#include "erp/sql/errors.h"
#include "erp/sql/parser.h"
#include "erp/sql/pieces.h"

namespace zebtell::erp::sql {
namespace {

struct RuleScopes {
    ExprPtr user;
    ExprPtr guest;
};

ExprPtr Parsed(std::string_view scope) {
    return scope.empty() || scope == AccessRule::kNoRows
               ? nullptr
               : Parser(scope, Style::kPolicy).ParseCondition();
}

std::unordered_map<const AccessRule*, RuleScopes> ParsePolicy() {
    std::unordered_map<const AccessRule*, RuleScopes> scopes;
    for (const AccessRule& rule : AccessPolicy()) {
        scopes.emplace(&rule, RuleScopes{Parsed(rule.user_scope), Parsed(rule.guest_scope)});
    }
    return scopes;
}

struct NumberName {
    std::string_view name;
    std::int64_t Reader::*number;
};

struct ListName {
    std::string_view name;
    std::vector<std::int64_t> Reader::*list;
};

constexpr NumberName kNumbers[] = {
    {"user", &Reader::user},
    {"partner", &Reader::partner},
    {"settlement_company", &Reader::settlement_company},
    {"parent", &Reader::parent},
    {"employee", &Reader::employee},
    {"contact", &Reader::contact},
    {"price_category", &Reader::price_category},
};

constexpr ListName kLists[] = {
    {"price_lists", &Reader::price_lists},
    {"saved_documents", &Reader::saved_documents},
};

}  // namespace

const Expr* RowScope(const AccessRule& rule, Role role) {
    static const std::unordered_map<const AccessRule*, RuleScopes> scopes = ParsePolicy();
    const RuleScopes& found = scopes.at(&rule);
    return role == Role::kUser ? found.user.get() : found.guest.get();
}

ReaderValue ValueOf(const Reader& reader, std::string_view name) {
    for (const NumberName& known : kNumbers) {
        if (known.name == name) {
            return {reader.*known.number, false};
        }
    }
    for (const ListName& known : kLists) {
        if (known.name == name) {
            return {JsonList(reader.*known.list), true};
        }
    }
    Fail("The access policy names an unknown value", name);
}

}  // namespace zebtell::erp::sql
