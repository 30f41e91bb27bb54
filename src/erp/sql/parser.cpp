#include "erp/sql/parser.h"

#include <charconv>

#include "base/text.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::sql {
namespace {

constexpr int kMostLevels = 100;

}  // namespace

void FailTooManyNodes() {
    Fail("The condition or statement holds too much");
}

Parser::Deeper::Deeper(Parser& parser) : parser_(parser) {
    if (parser.depth_ == kMostLevels) {
        Fail("The condition or statement nests too deeply");
    }
    ++parser.depth_;
}

ExprPtr Parser::ParseCondition() {
    ExprPtr condition = ParseOr();
    ExpectEnd();
    return condition;
}

SelectPtr Parser::ParseStatement() {
    if (lexer_.Peek().keyword != Keyword::kSelect) {
        Fail("Not a select statement", lexer_.Rest());
    }
    SelectPtr select = ParseSelect();
    ExpectEnd();
    return select;
}

std::vector<OrderItem> Parser::ParseOrderList() {
    std::vector<OrderItem> order = ParseOrder();
    ExpectEnd();
    return order;
}

bool Parser::AcceptKeyword(Keyword keyword) {
    if (lexer_.Peek().keyword != keyword) {
        return false;
    }
    lexer_.Take();
    return true;
}

bool Parser::AcceptSymbol(std::string_view symbol) {
    if (!lexer_.Peek().IsSymbol(symbol)) {
        return false;
    }
    lexer_.Take();
    return true;
}

bool Parser::AcceptWord(std::string_view word) {
    const Token& token = lexer_.Peek();
    if (token.kind != TokenKind::kName || !base::EqualNoCase(token.text, word)) {
        return false;
    }
    lexer_.Take();
    return true;
}

void Parser::Expect(Keyword keyword, std::string_view missing) {
    if (!AcceptKeyword(keyword)) {
        Fail("\"" + std::string(missing) + "\" is missing before", lexer_.Rest());
    }
}

void Parser::ExpectSymbol(std::string_view symbol) {
    if (!AcceptSymbol(symbol)) {
        Fail("\"" + std::string(symbol) + "\" is missing before",
             lexer_.Rest().empty() ? "the end" : lexer_.Rest());
    }
}

void Parser::ExpectEnd() {
    if (lexer_.Peek().kind != TokenKind::kEnd) {
        Fail("Not understood", lexer_.Rest());
    }
}

std::int64_t Parser::ExpectInteger() {
    const Token token = lexer_.Take();
    std::int64_t number = 0;
    const char* end = token.text.data() + token.text.size();
    if (token.kind != TokenKind::kInteger ||
        std::from_chars(token.text.data(), end, number).ec != std::errc()) {
        Fail("Not a whole number", token.text);
    }
    return number;
}

std::string_view Parser::ExpectName() {
    const Token token = lexer_.Take();
    const bool bare = token.kind == TokenKind::kName && !IsReserved(token.keyword);
    if (!bare && token.kind != TokenKind::kQuotedName) {
        Fail("A name is missing", token.text);
    }
    return token.text;
}

}  // namespace zebtell::erp::sql
