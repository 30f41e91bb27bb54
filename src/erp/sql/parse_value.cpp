#include <charconv>
#include <cmath>
#include <limits>

#include "base/text.h"
#include "erp/sql/errors.h"
#include "erp/sql/functions.h"
#include "erp/sql/literals.h"
#include "erp/sql/parser.h"

namespace zebtell::erp::sql {
namespace {

// The databases take left-deep trees of some 1,000 levels.
constexpr std::size_t kMostTerms = 500;

// The operator's sign, '\0' for anything else.
char OperationOf(const Token& token, std::string_view operations) {
    if (token.kind != TokenKind::kSymbol) {
        return '\0';
    }
    const char sign = token.text.front();
    const bool whole = token.text.size() == 1 || token.text == "||";
    return whole && operations.find(sign) != std::string_view::npos ? sign : '\0';
}

}  // namespace

ExprPtr Parser::ParseSum() {
    ExprPtr first = ParseProduct();
    if (!OperationOf(lexer_.Peek(), "+-|")) {
        return first;
    }
    return ParseChain(std::move(first), "+-|", &Parser::ParseProduct);
}

ExprPtr Parser::ParseProduct() {
    ExprPtr first = ParseSign();
    if (!OperationOf(lexer_.Peek(), "*/%")) {
        return first;
    }
    return ParseChain(std::move(first), "*/%", &Parser::ParseSign);
}

ExprPtr Parser::ParseChain(ExprPtr first,
                           std::string_view operations,
                           ExprPtr (Parser::*parse_operand)()) {
    Chain chain;
    chain.terms.push_back({' ', std::move(first)});
    while (const char operation = OperationOf(lexer_.Peek(), operations)) {
        lexer_.Take();
        chain.terms.push_back({operation, (this->*parse_operand)()});
        if (chain.terms.size() > kMostTerms) {
            Fail("The expression is too long");
        }
    }
    return Make(std::move(chain));
}

ExprPtr Parser::ParseSign() {
    const bool negative = AcceptSymbol("-");
    if (!negative && !AcceptSymbol("+")) {
        return ParsePrimary();
    }
    const Deeper deeper(*this);
    ExprPtr operand = ParseSign();
    if (!negative) {
        return operand;
    }
    if (auto* literal = std::get_if<Literal>(&operand->node)) {
        if (Negate(literal->value)) {
            return operand;
        }
    }
    return Make(Negative{std::move(operand)});
}

ExprPtr Parser::ParsePrimary() {
    const Token& next = lexer_.Peek();
    switch (next.kind) {
        case TokenKind::kInteger:
        case TokenKind::kNumber:
        case TokenKind::kText:
        case TokenKind::kDate:
            return ParseLiteral();
        case TokenKind::kParameter:
            return Make(Parameter{lexer_.Take().text});
        case TokenKind::kName:
        case TokenKind::kQuotedName:
            return ParseNamed();
        default:
            break;
    }
    if (!AcceptSymbol("(")) {
        Fail("A value is missing before", lexer_.Rest().empty() ? "the end" : lexer_.Rest());
    }
    ExprPtr inside =
        lexer_.Peek().keyword == Keyword::kSelect ? Make(Subquery{ParseSelect()}) : ParseOr();
    ExpectSymbol(")");
    return inside;
}

ExprPtr Parser::ParseLiteral() {
    const Token token = lexer_.Take();
    switch (token.kind) {
        case TokenKind::kText:
            return Make(Literal{lexer_.TextOf(token)});
        case TokenKind::kDate:
            return Make(Literal{DateOf(token.text)});
        default:
            return Make(Literal{NumberOf(token.text)});
    }
}

ExprPtr Parser::ParseNamed() {
    const Token token = lexer_.Take();
    const bool called = lexer_.Peek().IsSymbol("(");
    switch (token.keyword) {
        case Keyword::kCase:
            return ParseCase();
        case Keyword::kExists:
            return Make(Exists{ParseSelectInParentheses()});
        case Keyword::kNull:
            return Make(Literal{base::Value::Null()});
        case Keyword::kTrue:
        case Keyword::kFalse:
            return Make(Literal{token.keyword == Keyword::kTrue ? 1 : 0});
        case Keyword::kCast:
            return ParseCast();
        case Keyword::kConvert:
            return ParseConvert();
        default:
            break;
    }
    if (called && token.kind == TokenKind::kName) {
        return ParseCall(token.text);
    }
    if (IsReserved(token.keyword)) {
        Fail("A word that has no place here", token.text);
    }
    return ParsePath(token.text);
}

ExprPtr Parser::ParseCall(std::string_view name) {
    ExpectSymbol("(");
    std::string full_name(name);
    if (base::StartsWithNoCase(name, "date")) {
        full_name.append(" ").append(lexer_.Take().text);
        ExpectSymbol(",");
    }
    Call call{FindFunction(full_name), false, false, {}};
    if (!call.function) {
        Fail("No such function", full_name);
    }
    call.distinct = AcceptKeyword(Keyword::kDistinct);
    call.star = AcceptSymbol("*");
    if (!call.star && !lexer_.Peek().IsSymbol(")")) {
        call.arguments = ParseList();
    }
    ExpectSymbol(")");
    const std::size_t count = call.arguments.size();
    const bool star_fits = base::EqualNoCase(call.function->name, "count") && !call.distinct;
    if (call.star ? !star_fits : count < call.function->least || count > call.function->most) {
        Fail("The wrong number of arguments", full_name);
    }
    if (call.distinct && !call.function->aggregate) {
        Fail("\"distinct\" has no place here", full_name);
    }
    return Make(std::move(call));
}

ExprPtr Parser::ParsePath(std::string_view first) {
    Path path{{first}};
    while (AcceptSymbol(".")) {
        const Token part = lexer_.Take();
        if (part.kind != TokenKind::kName && part.kind != TokenKind::kQuotedName) {
            Fail("A name is missing behind", first);
        }
        path.parts.push_back(part.text);
    }
    return Make(std::move(path));
}

ExprPtr Parser::ParseCase() {
    const Deeper deeper(*this);
    Case result;
    if (lexer_.Peek().keyword != Keyword::kWhen) {
        result.subject = ParseSum();
    }
    Expect(Keyword::kWhen, "when");
    do {
        ExprPtr when = ParseOr();
        Expect(Keyword::kThen, "then");
        result.branches.push_back({std::move(when), ParseOr()});
    } while (AcceptKeyword(Keyword::kWhen));
    if (AcceptKeyword(Keyword::kElse)) {
        result.otherwise = ParseOr();
    }
    Expect(Keyword::kEnd, "end");
    return Make(std::move(result));
}

ExprPtr Parser::ParseCast() {
    Cast cast;
    ExpectSymbol("(");
    cast.operand = ParseOr();
    Expect(Keyword::kAs, "as");
    ParseType(cast);
    ExpectSymbol(")");
    return Make(std::move(cast));
}

ExprPtr Parser::ParseConvert() {
    Cast cast;
    ExpectSymbol("(");
    ParseType(cast);
    ExpectSymbol(",");
    cast.operand = ParseOr();
    ExpectSymbol(")");
    return Make(std::move(cast));
}

void Parser::ParseType(Cast& cast) {
    constexpr std::int64_t kMostDigits = 4000;
    const Token name = lexer_.Take();
    std::vector<std::int64_t> numbers;
    if (AcceptSymbol("(")) {
        do {
            numbers.push_back(ExpectInteger());
        } while (AcceptSymbol(","));
        ExpectSymbol(")");
    }
    cast.type = FindCastType(name.text, numbers.size());
    for (const std::int64_t number : numbers) {
        if (number > kMostDigits) {
            cast.type = nullptr;
        }
    }
    if (!cast.type) {
        Fail("No such type", name.text);
    }
    cast.length = numbers.empty() ? 0 : static_cast<int>(numbers[0]);
    cast.scale = numbers.size() < 2 ? 0 : static_cast<int>(numbers[1]);
}

}  // namespace zebtell::erp::sql
