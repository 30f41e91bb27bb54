#include "base/date_time.h"
#include "erp/sql/errors.h"
#include "erp/sql/policy_scopes.h"
#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

constexpr std::size_t kMostMarks = 500;  // of one list

// A date written as a text, compared with one that the database holds, is a date; a number compared
// with a text is a text, since SQL Server would make a number of every text to compare.
void TurnInto(ValueType compared_with, const Expr& written, BoundSql& printed) {
    const auto* literal = std::get_if<Literal>(&written.node);
    if (!literal || printed.text != "?") {
        return;
    }
    const auto* text = literal->value.As<std::string>();
    if (text && compared_with == ValueType::kDate) {
        if (const auto date = base::DateTime::FromIso(*text)) {
            printed.values.back() = *date;
        }
    } else if (compared_with == ValueType::kText && literal->value.As<std::int64_t>()) {
        printed.values.back() = literal->value.ToPlainText();
    }
}

struct PredicatePrinter {
    Context& context;
    Scope& scope;
    BoundSql& out;

    bool operator()(const Comparison& comparison) const {
        BoundSql left;
        BoundSql right;
        const ValueType left_type = PrintValue(context, *comparison.left, scope, left);
        const ValueType right_type = PrintValue(context, *comparison.right, scope, right);
        TurnInto(right_type, *comparison.left, left);
        TurnInto(left_type, *comparison.right, right);
        Append(out, std::move(left));
        out.text.append(" ").append(comparison.operation).append(" ");
        Append(out, std::move(right));
        return true;
    }

    bool operator()(const Like& like) const {
        BoundSql operand;
        BoundSql pattern;
        PrintOperand(context, *like.operand, scope, operand);
        {
            const Temporarily<bool> in_pattern(context.in_pattern, true);
            PrintOperand(context, *like.pattern, scope, pattern);
        }
        if (!like.negated && pattern.text == "?" && pattern.values[0] == base::Value("%")) {
            Append(out, std::move(operand));  // any text at all: nothing to look at
            out.text += " is not null";
        } else if (context.dialect == Dialect::kSqlite) {
            out.text += like.negated ? "not erp_like(" : "erp_like(";
            Append(out, std::move(operand));
            out.text += ", ";
            Append(out, std::move(pattern));
            out.text += ')';
        } else {
            PrintServerLike(like.negated, std::move(operand), std::move(pattern));
        }
        return true;
    }

    bool operator()(const In& in) const {
        const ValueType type = PrintOperand(context, *in.operand, scope, out);
        out.text += in.negated ? " not" : "";
        if (const auto* json = std::get_if<std::string>(&in.set)) {
            AppendInJson(out, *json, context.dialect, type == ValueType::kText);
        } else if (const auto* select = std::get_if<SelectPtr>(&in.set)) {
            out.text += " in (";
            const auto columns = PrintSelect(context, **select, &scope, SelectUse::kValues, out);
            if (columns.size() != 1) {
                Fail("The select behind \"in\" has to give one column");
            }
            out.text += ')';
        } else {
            PrintValues(std::get<std::vector<ExprPtr>>(in.set), type);
        }
        return true;
    }

    bool operator()(const Between& between) const {
        const ValueType type = PrintOperand(context, *between.operand, scope, out);
        out.text += between.negated ? " not between " : " between ";
        PrintCompared(*between.low, type);
        out.text += " and ";
        PrintCompared(*between.high, type);
        return true;
    }

    bool operator()(const IsNull& is_null) const {
        PrintOperand(context, *is_null.operand, scope, out);
        out.text += is_null.negated ? " is not null" : " is null";
        return true;
    }

    template <class Other>
    bool operator()(const Other&) const {
        return false;
    }

    // The blanks that fill up a column of a fixed width are no part of its text, and would stand
    // in the way unless the pattern takes any end.
    void PrintServerLike(bool negated, BoundSql&& operand, BoundSql&& pattern) const {
        const bool any_end = pattern.text == "?" && pattern.values[0].ToPlainText().ends_with('%');
        out.text += any_end ? "" : "rtrim(";
        Append(out, std::move(operand));
        out.text += any_end ? "" : ")";
        out.text += negated ? " not like " : " like ";
        Append(out, std::move(pattern));
        out.text += " escape '\\'";
    }

    void PrintValues(const std::vector<ExprPtr>& values, ValueType type) const {
        const auto* parameter = std::get_if<Parameter>(&values.front()->node);
        if (parameter && values.size() == 1) {
            ReaderValue list = ValueOf(context.reader, parameter->name);
            AppendInJson(out, list.value.text(), context.dialect, false);
            return;
        }
        // SQL Server takes 2,100 values a statement.
        const Temporarily<bool> literals(context.inline_literals,
                                         context.inline_literals || values.size() > kMostMarks);
        std::string_view glue = " in (";
        for (const ExprPtr& value : values) {
            out.text += glue;
            PrintCompared(*value, type);
            glue = ", ";
        }
        out.text += ')';
    }

    void PrintCompared(const Expr& value, ValueType with) const {
        BoundSql printed;
        PrintOperand(context, value, scope, printed);
        TurnInto(with, value, printed);
        Append(out, std::move(printed));
    }
};

}  // namespace

bool TryPrintPredicate(Context& context, const Expr& condition, Scope& scope, BoundSql& out) {
    Joins children;
    BoundSql printed;
    {
        const Temporarily<Joins*> within(context.children, &children);
        if (!std::visit(PredicatePrinter{context, scope, printed}, condition.node)) {
            return false;
        }
    }
    if (children.tables.empty()) {
        Append(out, std::move(printed));
    } else {
        PrintChildren(context, children, std::move(printed), out);
    }
    return true;
}

}  // namespace zebtell::erp::sql
