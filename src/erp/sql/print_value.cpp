#include <charconv>
#include <cmath>

#include "erp/sql/errors.h"
#include "erp/sql/like_pattern.h"
#include "erp/sql/policy_scopes.h"
#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

ValueType TypeOf(const base::Value& value) {
    switch (value.kind()) {
        case base::Value::Kind::kInteger:
            return ValueType::kInteger;
        case base::Value::Kind::kDouble:
            return ValueType::kNumber;
        case base::Value::Kind::kText:
            return ValueType::kText;
        case base::Value::Kind::kDateTime:
            return ValueType::kDate;
        default:
            return ValueType::kUnknown;
    }
}

// Whether the number has few enough digits to be written without an exponent.
bool IsShort(double number) {
    return number == 0 || (std::abs(number) >= 1e-9 && std::abs(number) < 1e15);
}

void AppendNumber(BoundSql& out, const base::Value& value) {
    char digits[40];
    char* const end = digits + sizeof digits;
    const auto* integer = value.As<std::int64_t>();
    const auto* number = value.As<double>();
    const auto written = integer ? std::to_chars(digits, end, *integer)
                         : IsShort(*number)
                             ? std::to_chars(digits, end, *number, std::chars_format::fixed)
                             : std::to_chars(digits, end, *number);
    out.text.append(digits, written.ptr);
}

struct ValuePrinter {
    Context& context;
    Scope& scope;
    BoundSql& out;

    ValueType operator()(const Literal& literal) const {
        const base::Value& value = literal.value;
        const ValueType type = TypeOf(value);
        if (value.IsNull()) {
            out.text += "null";
        } else if (type == ValueType::kText) {
            PrintText(value.text());
        } else if (IsWritten(value, type)) {
            AppendNumber(out, value);
        } else {
            AppendValue(out, value);
        }
        return type;
    }

    ValueType operator()(const Parameter& parameter) const {
        const ReaderValue value = ValueOf(context.reader, parameter.name);
        if (value.is_list) {
            Fail("A list of the reader has no place here", parameter.name);
        }
        AppendValue(out, value.value);
        return ValueType::kNumber;
    }

    ValueType operator()(const Path& path) const {
        const ResolvedColumn column = context.names.Resolve(path, scope, context.children);
        PrintColumn(context, column, out);
        return column.type;
    }

    // Never "--", which begins a comment.
    ValueType operator()(const Negative& negative) const {
        out.text += "-(";
        PrintValue(context, *negative.operand, scope, out);
        out.text += ')';
        return ValueType::kNumber;
    }

    ValueType operator()(const Subquery& subquery) const {
        out.text += '(';
        const auto columns =
            PrintSelect(context, *subquery.select, &scope, SelectUse::kValues, out);
        out.text += ')';
        return columns.front().type;
    }

    ValueType operator()(const Case& choice) const {
        out.text += "case";
        if (choice.subject) {
            out.text += ' ';
            PrintValue(context, *choice.subject, scope, out);
        }
        ValueType type = ValueType::kUnknown;
        for (const Case::Branch& branch : choice.branches) {
            out.text += " when ";
            choice.subject ? void(PrintValue(context, *branch.when, scope, out))
                           : PrintCondition(context, *branch.when, scope, out);
            out.text += " then ";
            type = PrintValue(context, *branch.then, scope, out);
        }
        if (choice.otherwise) {
            out.text += " else ";
            PrintValue(context, *choice.otherwise, scope, out);
        }
        out.text += " end";
        return type == ValueType::kInteger ? ValueType::kNumber : type;
    }

    ValueType operator()(const Chain& chain) const {
        return PrintChain(context, chain, scope, out);
    }
    ValueType operator()(const Call& call) const { return PrintCall(context, call, scope, out); }
    ValueType operator()(const Cast& cast) const { return PrintCast(context, cast, scope, out); }

    template <class Condition>
    ValueType operator()(const Condition&) const {
        Fail("A condition stands where a value is needed");
    }

    // SQL Server takes a written number with a mark as a decimal, where a value would be a binary
    // number and make all that it meets inexact.
    bool IsWritten(const base::Value& value, ValueType type) const {
        const auto* number = value.As<double>();
        const bool exact = number && context.dialect == Dialect::kSqlServer && IsShort(*number);
        return exact || (context.inline_literals && type != ValueType::kDate);
    }

    void PrintText(std::string_view text) const {
        std::string printed = context.in_pattern ? LikePattern(text, context.style, context.dialect)
                                                 : std::string(text);
        if (context.inline_literals) {
            AppendTextLiteral(out, printed, context.dialect);
        } else {
            AppendValue(out, std::move(printed));
        }
    }
};

}  // namespace

ValueType PrintValue(Context& context, const Expr& value, Scope& scope, BoundSql& out) {
    return std::visit(ValuePrinter{context, scope, out}, value.node);
}

ValueType PrintOperand(Context& context, const Expr& value, Scope& scope, BoundSql& out) {
    if (!std::holds_alternative<Chain>(value.node)) {
        return PrintValue(context, value, scope, out);
    }
    out.text += '(';
    const ValueType type = PrintValue(context, value, scope, out);
    out.text += ')';
    return type;
}

}  // namespace zebtell::erp::sql
