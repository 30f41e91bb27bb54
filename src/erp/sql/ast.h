#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "base/value.h"

namespace zebtell::erp::sql {

// What a text says, as the parser read it. Names are views of the text, which outlives the tree.

struct Function;  // functions.h
struct CastType;
struct Expr;
struct Select;
using ExprPtr = std::unique_ptr<Expr>;
using SelectPtr = std::unique_ptr<Select>;

// Values

struct Literal {
    base::Value value;  // null, integer, double, text or date
};

struct Parameter {
    std::string_view name;  // of a value of the reader, in the access policy only
};

// A column, with the alias, table or links that lead to it: "GRArticle.GRTax.TaxPercent".
struct Path {
    std::vector<std::string_view> parts;
};

struct Negative {
    ExprPtr operand;
};

// Operators of one rank, from left to right: a - b + c. A long chain is no deep tree.
struct Chain {
    struct Term {
        char operation;  // '+', '-', '*', '/', '%' or '|' (concatenation); ' ' for the first
        ExprPtr operand;
    };
    std::vector<Term> terms;
};

struct Call {
    const Function* function = nullptr;
    bool distinct = false;
    bool star = false;  // count(*)
    std::vector<ExprPtr> arguments;
};

struct Cast {
    ExprPtr operand;
    const CastType* type = nullptr;
    int length = 0;  // or precision; 0: none
    int scale = 0;
};

struct Case {
    struct Branch {
        ExprPtr when;
        ExprPtr then;
    };
    ExprPtr subject;  // none: the branches are conditions
    std::vector<Branch> branches;
    ExprPtr otherwise;  // none: null
};

struct Subquery {
    SelectPtr select;
};

// Conditions

struct Logic {
    bool is_and = true;
    std::vector<ExprPtr> operands;
};

struct Not {
    ExprPtr operand;
};

struct Comparison {
    std::string_view operation;  // "=", "<>", "<", "<=", ">", ">="
    ExprPtr left;
    ExprPtr right;
};

struct Like {
    bool negated = false;
    ExprPtr operand;
    ExprPtr pattern;
};

struct In {
    bool negated = false;
    ExprPtr operand;
    // Values, whole numbers as JSON ("[1,2]"), or a subquery.
    std::variant<std::vector<ExprPtr>, std::string, SelectPtr> set;
};

struct Between {
    bool negated = false;
    ExprPtr operand;
    ExprPtr low;
    ExprPtr high;
};

struct IsNull {
    bool negated = false;
    ExprPtr operand;
};

struct Exists {
    SelectPtr select;
};

struct Expr {
    std::variant<Literal,
                 Parameter,
                 Path,
                 Negative,
                 Chain,
                 Call,
                 Cast,
                 Case,
                 Subquery,
                 Logic,
                 Not,
                 Comparison,
                 Like,
                 In,
                 Between,
                 IsNull,
                 Exists>
        node;
};

// Select statements

struct Item {
    bool star = false;
    std::string_view star_of;  // the alias before ".*"; empty: every table
    ExprPtr expression;
    std::string_view alias;
};

struct TableRef {
    enum class Join { kFirst, kInner, kLeft };

    Join join = Join::kFirst;
    std::string_view table;  // empty: the subquery
    SelectPtr subquery;
    std::string_view alias;
    bool no_lock = false;
    ExprPtr on;  // none: every pair of rows
};

struct OrderItem {
    ExprPtr expression;
    bool descending = false;
};

struct Select {
    bool distinct = false;
    std::optional<std::int64_t> top;
    std::vector<Item> items;
    std::vector<TableRef> from;
    ExprPtr where;
    std::vector<ExprPtr> group;
    ExprPtr having;
    std::vector<OrderItem> order;
};

}  // namespace zebtell::erp::sql
