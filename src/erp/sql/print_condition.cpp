#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

void PrintLogic(Context& context, const Logic& logic, Scope& scope, BoundSql& out) {
    const std::string_view glue = logic.is_and ? " and " : " or ";
    bool first = true;
    for (const ExprPtr& operand : logic.operands) {
        out.text += first ? "" : glue;
        first = false;
        const auto* inner = std::get_if<Logic>(&operand->node);
        out.text += inner ? "(" : "";
        PrintCondition(context, *operand, scope, out);
        out.text += inner ? ")" : "";
    }
}

}  // namespace

void PrintCondition(Context& context, const Expr& condition, Scope& scope, BoundSql& out) {
    if (const auto* logic = std::get_if<Logic>(&condition.node)) {
        PrintLogic(context, *logic, scope, out);
    } else if (const auto* negation = std::get_if<Not>(&condition.node)) {
        out.text += "not (";
        PrintCondition(context, *negation->operand, scope, out);
        out.text += ')';
    } else if (const auto* exists = std::get_if<Exists>(&condition.node)) {
        out.text += "exists (";
        PrintSelect(context, *exists->select, &scope, SelectUse::kValues, out);
        out.text += ')';
    } else if (!TryPrintPredicate(context, condition, scope, out)) {
        PrintOperand(context, condition, scope, out);
        out.text += " <> 0";
    }
}

void PrintAndPart(Context& context, const Expr& condition, Scope& scope, BoundSql& out) {
    const auto* logic = std::get_if<Logic>(&condition.node);
    const bool is_or = logic && !logic->is_and;
    out.text += is_or ? "(" : "";
    PrintCondition(context, condition, scope, out);
    out.text += is_or ? ")" : "";
}

}  // namespace zebtell::erp::sql
