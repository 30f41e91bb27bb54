#include <string>

#include "erp/sql/errors.h"
#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

// A template of functions.h with what stands for its marks.
struct Filling {
    std::vector<BoundSql> arguments;   // "$1", or "$*" for all
    std::vector<std::string> numbers;  // "@1"
};

std::size_t IndexOf(char digit) {
    return static_cast<std::size_t>(digit - '1');
}

void Fill(std::string_view pattern, Filling& filling, BoundSql& out) {
    for (std::size_t i = 0; i < pattern.size(); ++i) {
        if (pattern[i] == '$' && pattern[i + 1] == '*') {
            for (BoundSql& argument : filling.arguments) {
                out.text += &argument == filling.arguments.data() ? "" : ", ";
                Append(out, std::move(argument));
            }
        } else if (pattern[i] == '$') {
            Append(out, std::move(filling.arguments[IndexOf(pattern[i + 1])]));
        } else if (pattern[i] == '@') {
            out.text += filling.numbers[IndexOf(pattern[i + 1])];
        } else {
            out.text += pattern[i];
            continue;
        }
        ++i;
    }
}

// A whole number as it is written, "" for any other argument.
std::string WrittenNumber(const Expr& argument) {
    const auto* literal = std::get_if<Literal>(&argument.node);
    const auto* number = literal ? literal->value.As<std::int64_t>() : nullptr;
    if (!number) {
        return "";
    }
    const std::string digits = std::to_string(*number);
    return *number < 0 ? "(" + digits + ")" : digits;
}

bool IsNumberMark(std::string_view pattern, std::size_t argument) {
    return pattern.find("@" + std::to_string(argument + 1)) != std::string_view::npos;
}

ValueType Computed(ValueType type) {
    return type == ValueType::kInteger ? ValueType::kNumber : type;
}

}  // namespace

ValueType PrintCall(Context& context, const Call& call, Scope& scope, BoundSql& out) {
    if (call.star) {
        out.text += context.dialect == Dialect::kSqlite ? "count(*)" : "count_big(*)";
        return ValueType::kNumber;
    }
    const std::string_view pattern = call.function->Print(context.dialect);
    const std::size_t count = call.arguments.size();
    Filling filling{std::vector<BoundSql>(count), std::vector<std::string>(count)};
    ValueType type = call.function->result;
    for (std::size_t i = 0; i < count; ++i) {
        const Expr& argument = *call.arguments[i];
        if (IsNumberMark(pattern, i)) {
            filling.numbers[i] = WrittenNumber(argument);
            if (filling.numbers[i].empty()) {
                Fail("A whole number is needed", call.function->name);
            }
            continue;
        }
        filling.arguments[i].text = call.distinct ? "distinct " : "";
        const ValueType printed = PrintValue(context, argument, scope, filling.arguments[i]);
        type = i == 0 && type == ValueType::kUnknown ? printed : type;
    }
    Fill(pattern, filling, out);
    return Computed(type);
}

ValueType PrintCast(Context& context, const Cast& cast, Scope& scope, BoundSql& out) {
    Filling filling{std::vector<BoundSql>(1),
                    {std::to_string(cast.length), std::to_string(cast.scale)}};
    PrintValue(context, *cast.operand, scope, filling.arguments[0]);
    Fill(cast.type->Print(context.dialect), filling, out);
    return cast.type->result;
}

}  // namespace zebtell::erp::sql
