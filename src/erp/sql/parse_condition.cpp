#include <charconv>

#include "erp/sql/errors.h"
#include "erp/sql/parser.h"

namespace zebtell::erp::sql {

ExprPtr Parser::ParseOr() {
    const Deeper deeper(*this);
    ExprPtr first = ParseAnd();
    if (lexer_.Peek().keyword != Keyword::kOr) {
        return first;
    }
    Logic logic{false, {}};
    logic.operands.push_back(std::move(first));
    while (AcceptKeyword(Keyword::kOr)) {
        logic.operands.push_back(ParseAnd());
    }
    return Make(std::move(logic));
}

ExprPtr Parser::ParseAnd() {
    ExprPtr first = ParseNot();
    if (lexer_.Peek().keyword != Keyword::kAnd) {
        return first;
    }
    Logic logic{true, {}};
    logic.operands.push_back(std::move(first));
    while (AcceptKeyword(Keyword::kAnd)) {
        logic.operands.push_back(ParseNot());
    }
    return Make(std::move(logic));
}

ExprPtr Parser::ParseNot() {
    if (!AcceptKeyword(Keyword::kNot)) {
        return ParsePredicate();
    }
    const Deeper deeper(*this);
    return Make(Not{ParseNot()});
}

ExprPtr Parser::ParsePredicate() {
    ExprPtr left = ParseSum();
    if (AcceptKeyword(Keyword::kIs)) {
        return ParseIsNull(std::move(left));
    }
    const bool negated = AcceptKeyword(Keyword::kNot);
    if (AcceptKeyword(Keyword::kLike)) {
        return Make(Like{negated, std::move(left), ParseSum()});
    }
    if (AcceptKeyword(Keyword::kIn)) {
        return ParseIn(std::move(left), negated);
    }
    if (AcceptKeyword(Keyword::kBetween)) {
        return ParseBetween(std::move(left), negated);
    }
    if (negated) {
        Fail("Not understood", lexer_.Rest());
    }
    return ParseComparison(std::move(left));
}

ExprPtr Parser::ParseComparison(ExprPtr left) {
    constexpr std::string_view kOperations[] = {"=", "<>", "<", "<=", ">", ">="};
    if (AcceptSymbol("!=")) {
        return Make(Comparison{"<>", std::move(left), ParseSum()});
    }
    for (const std::string_view operation : kOperations) {
        if (AcceptSymbol(operation)) {
            return Make(Comparison{operation, std::move(left), ParseSum()});
        }
    }
    return left;
}

ExprPtr Parser::ParseIsNull(ExprPtr operand) {
    const bool negated = AcceptKeyword(Keyword::kNot);
    Expect(Keyword::kNull, "null");
    return Make(IsNull{negated, std::move(operand)});
}

ExprPtr Parser::ParseIn(ExprPtr operand, bool negated) {
    In in{negated, std::move(operand), {}};
    ExpectSymbol("(");
    std::string integers;
    if (lexer_.Peek().keyword == Keyword::kSelect) {
        in.set = ParseSelect();
        ExpectSymbol(")");
    } else if (ParseIntegers(integers)) {
        in.set = std::move(integers);
    } else {
        in.set = ParseList();
        ExpectSymbol(")");
    }
    return Make(std::move(in));
}

// A list of nothing but whole numbers, its ")" included; an empty list, too, as of a page that
// shows no articles. Reads nothing when the list is of another kind.
bool Parser::ParseIntegers(std::string& json) {
    const Lexer before = lexer_;
    json = "[";
    while (!lexer_.Peek().IsSymbol(")")) {
        const bool negative = AcceptSymbol("-");
        const Token token = lexer_.Take();
        std::int64_t number = 0;
        const char* end = token.text.data() + token.text.size();
        if (token.kind != TokenKind::kInteger ||
            std::from_chars(token.text.data(), end, number).ec != std::errc() ||
            !(lexer_.Peek().IsSymbol(",") || lexer_.Peek().IsSymbol(")"))) {
            lexer_ = before;
            return false;
        }
        char digits[24];
        const auto written =
            std::to_chars(digits, digits + sizeof digits, negative ? -number : number);
        json.append(json.size() > 1 ? "," : "").append(digits, written.ptr);
        if (AcceptSymbol(",") && lexer_.Peek().IsSymbol(")")) {
            Fail("A number is missing before", lexer_.Rest());
        }
    }
    json += ']';
    lexer_.Take();
    return true;
}

ExprPtr Parser::ParseBetween(ExprPtr operand, bool negated) {
    ExprPtr low = ParseSum();
    Expect(Keyword::kAnd, "and");
    return Make(Between{negated, std::move(operand), std::move(low), ParseSum()});
}

}  // namespace zebtell::erp::sql
