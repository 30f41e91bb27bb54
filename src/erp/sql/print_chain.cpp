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

// SQL Server adds unless both are texts.
void MakeText(const Context& context, Operand& operand) {
    if (context.dialect == Dialect::kSqlServer && operand.type != ValueType::kText) {
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

// SQLite would drop the remainder of amounts that are whole.
void Divide(Operand& left, Operand&& right) {
    Wrap(left.text, "erp_div(", ", ");
    Append(left.text, std::move(right.text));
    left.text.text += ')';
    left.type = ValueType::kNumber;
    left.operation = '/';
}

void Compute(char operation, Operand& left, Operand&& right) {
    left.text.text.append(" ").append(1, operation).append(" ");
    Append(left.text, std::move(right.text));
    const bool whole = left.type == ValueType::kInteger && right.type == ValueType::kInteger;
    left.type = whole ? ValueType::kInteger : ValueType::kNumber;
    left.operation = operation;
}

void Join(const Context& context, char operation, Operand& left, Operand&& right) {
    const bool text = left.type == ValueType::kText || right.type == ValueType::kText;
    const bool whole = left.type == ValueType::kInteger && right.type == ValueType::kInteger;
    if (operation == '|' || (operation == '+' && text)) {
        Concatenate(context, left, std::move(right));
    } else if (operation == '/' && !whole && context.dialect == Dialect::kSqlite) {
        Divide(left, std::move(right));
    } else {
        Compute(operation, left, std::move(right));
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
