#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "erp/sql/ast.h"
#include "erp/sql/lexer.h"

namespace zebtell::erp::sql {

// Reads a text into a tree. Whatever the grammar does not know is a RuntimeError kStatementFailed,
// as are texts that nest too deeply or hold too much. The text outlives the tree.
//
//   select     = SELECT [DISTINCT] [TOP n] item {"," item} FROM table {join}
//                [WHERE or] [GROUP BY or {"," or}] [HAVING or] [ORDER BY order]
//   item       = "*" | alias ".*" | or [[AS] alias]
//   table      = (name | "(" select ")") [[AS] alias] [WITH "(" NOLOCK ")"]
//   join       = "," table | CROSS JOIN table | [INNER | LEFT [OUTER]] JOIN table ON or
//   order      = column [ASC | DESC] {"," column [ASC | DESC]}; a path, or a position
//   or         = and {OR and}
//   and        = not {AND not}
//   not        = NOT not | predicate
//   predicate  = sum [comparison sum | IS [NOT] NULL | [NOT] LIKE sum
//                     | [NOT] IN "(" (select | values) ")" | [NOT] BETWEEN sum AND sum]
//   sum        = product {("+" | "-" | "||") product}
//   product    = sign {("*" | "/" | "%") sign}
//   sign       = ("-" | "+") sign | primary
//   primary    = number | text | date | NULL | TRUE | FALSE | path | call | CASE ... END
//                | EXISTS "(" select ")" | "(" select ")" | "(" or ")"
class Parser {
  public:
    Parser(std::string_view text, Style style, std::span<const data::Filter::Span> typed = {})
        : lexer_(text, style, typed) {}

    // Each reads the whole text.
    ExprPtr ParseCondition();
    SelectPtr ParseStatement();
    std::vector<OrderItem> ParseOrderList();

  private:
    class Deeper;

    // parser.cpp
    bool AcceptKeyword(Keyword keyword);
    bool AcceptSymbol(std::string_view symbol);
    bool AcceptWord(std::string_view word);
    void Expect(Keyword keyword, std::string_view missing);
    void ExpectSymbol(std::string_view symbol);
    void ExpectEnd();
    std::int64_t ExpectInteger();
    std::string_view ExpectName();
    template <class Node>
    ExprPtr Make(Node node);

    // parse_select.cpp
    SelectPtr ParseSelect();
    SelectPtr ParseSelectInParentheses();
    void ParseTop(Select& select);
    Item ParseItem();
    bool ParseStar(Item& item);
    std::string_view ParseAlias();
    void ParseFrom(Select& select);
    TableRef ParseTable();
    bool ParseLockHint();
    bool ParseJoin(Select& select);
    std::vector<ExprPtr> ParseList();
    std::vector<OrderItem> ParseOrder();

    // parse_condition.cpp
    ExprPtr ParseOr();
    ExprPtr ParseAnd();
    ExprPtr ParseNot();
    ExprPtr ParsePredicate();
    ExprPtr ParseComparison(ExprPtr left);
    ExprPtr ParseIsNull(ExprPtr operand);
    ExprPtr ParseIn(ExprPtr operand, bool negated);
    bool ParseIntegers(std::string& json);
    ExprPtr ParseBetween(ExprPtr operand, bool negated);

    // parse_value.cpp
    ExprPtr ParseSum();
    ExprPtr ParseProduct();
    ExprPtr ParseChain(ExprPtr first,
                       std::string_view operations,
                       ExprPtr (Parser::*parse_operand)());
    ExprPtr ParseSign();
    ExprPtr ParsePrimary();
    ExprPtr ParseLiteral();
    ExprPtr ParseNamed();
    ExprPtr ParseCall(std::string_view name);
    ExprPtr ParsePath(std::string_view first);
    ExprPtr ParseCase();
    ExprPtr ParseCast();
    ExprPtr ParseConvert();
    void ParseType(Cast& cast);

    Lexer lexer_;
    int depth_ = 0;
    int nodes_ = 0;
};

// Counts one level of nesting while it lives.
class Parser::Deeper {
  public:
    explicit Deeper(Parser& parser);
    ~Deeper() { --parser_.depth_; }
    Deeper(const Deeper&) = delete;
    Deeper& operator=(const Deeper&) = delete;

  private:
    Parser& parser_;
};

constexpr int kMostNodes = 20000;
[[noreturn]] void FailTooManyNodes();

template <class Node>
ExprPtr Parser::Make(Node node) {
    if (++nodes_ > kMostNodes) {
        FailTooManyNodes();
    }
    auto made = std::make_unique<Expr>();
    made->node = std::move(node);
    return made;
}

}  // namespace zebtell::erp::sql
