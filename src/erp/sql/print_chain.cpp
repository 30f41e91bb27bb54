#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

// What has been read of the chain so far.
struct Operand {
    BoundSql text;
    ValueType type;
    char operation;  // that joined it; ' ' for one operand
    bool is_number;  // written, and not 0
};

bool IsWrittenNumber(const Expr& value) {
    const auto* literal = std::get_if<Literal>(&value.node);
    return literal && !literal->value.IsNull() && !literal->value.As<std::string>() &&
           !literal->value.As<base::DateTime>() && literal->value.ToDouble() != 0;
}

// SQL Server computes with as many digits as the types of both numbers may have, and drops decimals
// when these are too many: a written 100 has three, where a value would have 19.
Operand PrintTerm(Context& context, const Chain::Term& term, Scope& scope) {
    const bool is_number = IsWrittenNumber(*term.operand);
    const bool is_written = is_number && context.dialect == Dialect::kSqlServer;
    const Temporarily<bool> literals(context.inline_literals,
                                     context.inline_literals || is_written);
    Operand operand{{}, ValueType::kUnknown, ' ', is_number};
    operand.type = PrintOperand(context, *term.operand, scope, operand.text);
    return operand;
}

// Divided by 0, SQLite gives null, where SQL Server ends the statement.
void AppendDivisor(const Context& context, BoundSql& out, Operand&& divisor) {
    const bool may_be_zero = context.dialect == Dialect::kSqlServer && !divisor.is_number;
    out.text += may_be_zero ? "nullif(" : "";
    Append(out, std::move(divisor.text));
    out.text += may_be_zero ? ", 0)" : "";
}

void Wrap(BoundSql& text, std::string_view before, std::string_view after) {
    Prepend(text, before);
    text.text += after;
}

// SQL Server adds unless both are texts. Dates read as SQLite has them, without a time of midnight.
void MakeText(const Context& context, Operand& operand) {
    if (context.dialect == Dialect::kSqlite || operand.type == ValueType::kText) {
        return;
    }
    if (operand.type == ValueType::kDate) {
        Wrap(operand.text, "replace(convert(nvarchar(19), ", ", 120), N' 00:00:00', N'')");
    } else {
        Wrap(operand.text, "cast(", " as nvarchar(4000))");
    }
}

void Concatenate(const Context& context, Operand& left, Operand&& right) {
    if (left.operation == '+' || left.operation == '-') {
        Wrap(left.text, "(", ")");
    }
    MakeText(context, left);
    MakeText(context, right);
    left.text.text += context.dialect == Dialect::kSqlite ? " || " : " + ";
    Append(left.text, std::move(right.text));
    left.type = ValueType::kText;
    left.operation = '|';
}

bool AreWhole(const Operand& left, const Operand& right) {
    return left.type == ValueType::kInteger && right.type == ValueType::kInteger;
}

// Both databases would drop the remainder of amounts that are whole.
void DivideExactly(const Context& context, Operand& left, Operand&& right) {
    if (context.dialect == Dialect::kSqlite) {
        Wrap(left.text, "erp_div(", ", ");
        Append(left.text, std::move(right.text));
        left.text.text += ')';
    } else {
        left.text.text += " * 1.0 / ";
        AppendDivisor(context, left.text, std::move(right));
    }
    left.type = ValueType::kNumber;
    left.operation = '/';
}

void Compute(const Context& context, char operation, Operand& left, Operand&& right) {
    left.type = AreWhole(left, right) ? ValueType::kInteger : ValueType::kNumber;
    left.text.text.append(" ").append(1, operation).append(" ");
    if (operation == '/' || operation == '%') {
        AppendDivisor(context, left.text, std::move(right));
    } else {
        Append(left.text, std::move(right.text));
    }
    left.operation = operation;
}

void Join(const Context& context, char operation, Operand& left, Operand&& right) {
    const bool text = left.type == ValueType::kText || right.type == ValueType::kText;
    if (operation == '|' || (operation == '+' && text)) {
        Concatenate(context, left, std::move(right));
    } else if (operation == '/' && !AreWhole(left, right)) {
        DivideExactly(context, left, std::move(right));
    } else {
        Compute(context, operation, left, std::move(right));
    }
}

}  // namespace

ValueType PrintChain(Context& context, const Chain& chain, Scope& scope, BoundSql& out) {
    Operand left = PrintTerm(context, chain.terms.front(), scope);
    for (std::size_t i = 1; i < chain.terms.size(); ++i) {
        const Chain::Term& term = chain.terms[i];
        Join(context, term.operation, left, PrintTerm(context, term, scope));
    }
    Append(out, std::move(left.text));
    return left.type;
}

}  // namespace zebtell::erp::sql
