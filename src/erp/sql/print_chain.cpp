#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

// What has been read of the chain so far.
struct Operand {
    BoundSql text;
    ValueType type;
    char operation;  // that joined it; ' ' for one operand
};

Operand PrintTerm(Context& context, const Chain::Term& term, Scope& scope) {
    Operand operand{{}, ValueType::kUnknown, ' '};
    operand.type = PrintOperand(context, *term.operand, scope, operand.text);
    return operand;
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
        left.text.text += " * 1.0 / nullif(";
        Append(left.text, std::move(right.text));
        left.text.text += ", 0)";
    }
    left.type = ValueType::kNumber;
    left.operation = '/';
}

void Compute(const Context& context, char operation, Operand& left, Operand&& right) {
    // Divided by 0, SQLite gives null, where SQL Server ends the statement.
    if (context.dialect == Dialect::kSqlServer && (operation == '/' || operation == '%')) {
        Wrap(right.text, "nullif(", ", 0)");
    }
    left.text.text.append(" ").append(1, operation).append(" ");
    Append(left.text, std::move(right.text));
    left.type = AreWhole(left, right) ? ValueType::kInteger : ValueType::kNumber;
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
