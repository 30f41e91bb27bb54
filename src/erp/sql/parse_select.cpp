#include "base/text.h"
#include "erp/sql/errors.h"
#include "erp/sql/parser.h"

namespace zebtell::erp::sql {
namespace {

// Links of a page may say the order of a statement: they choose columns, and compute nothing.
bool IsColumn(const Expr& expression) {
    return std::holds_alternative<Path>(expression.node) ||
           std::holds_alternative<Literal>(expression.node);
}

}  // namespace

SelectPtr Parser::ParseSelect() {
    const Deeper deeper(*this);
    auto select = std::make_unique<Select>();
    Expect(Keyword::kSelect, "select");
    select->distinct = AcceptKeyword(Keyword::kDistinct);
    ParseTop(*select);
    do {
        select->items.push_back(ParseItem());
    } while (AcceptSymbol(","));
    ParseFrom(*select);
    if (AcceptKeyword(Keyword::kWhere)) {
        select->where = ParseOr();
    }
    if (AcceptKeyword(Keyword::kGroup)) {
        Expect(Keyword::kBy, "by");
        select->group = ParseList();
    }
    if (AcceptKeyword(Keyword::kHaving)) {
        select->having = ParseOr();
    }
    if (AcceptKeyword(Keyword::kOrder)) {
        Expect(Keyword::kBy, "by");
        select->order = ParseOrder();
    }
    return select;
}

SelectPtr Parser::ParseSelectInParentheses() {
    ExpectSymbol("(");
    SelectPtr select = ParseSelect();
    ExpectSymbol(")");
    return select;
}

void Parser::ParseTop(Select& select) {
    if (!AcceptKeyword(Keyword::kTop)) {
        return;
    }
    const bool in_parentheses = AcceptSymbol("(");
    select.top = ExpectInteger();
    if (in_parentheses) {
        ExpectSymbol(")");
    }
}

Item Parser::ParseItem() {
    Item item;
    if (!ParseStar(item)) {
        item.expression = ParseOr();
        item.alias = ParseAlias();
    }
    return item;
}

bool Parser::ParseStar(Item& item) {
    if (AcceptSymbol("*")) {
        item.star = true;
        return true;
    }
    const Lexer before = lexer_;
    const Token name = lexer_.Take();
    if ((name.kind == TokenKind::kName || name.kind == TokenKind::kQuotedName) &&
        AcceptSymbol(".") && AcceptSymbol("*")) {
        item.star = true;
        item.star_of = name.text;
        return true;
    }
    lexer_ = before;
    return false;
}

// Empty when there is none.
std::string_view Parser::ParseAlias() {
    const Token& next = lexer_.Peek();
    if (AcceptKeyword(Keyword::kAs) || next.kind == TokenKind::kQuotedName ||
        (next.kind == TokenKind::kName && !IsReserved(next.keyword))) {
        return ExpectName();
    }
    return {};
}

void Parser::ParseFrom(Select& select) {
    Expect(Keyword::kFrom, "from");
    select.from.push_back(ParseTable());
    while (ParseJoin(select)) {
    }
}

TableRef Parser::ParseTable() {
    TableRef table;
    if (lexer_.Peek().IsSymbol("(")) {
        table.subquery = ParseSelectInParentheses();
    } else {
        table.table = ExpectName();
        if (base::EqualNoCase(table.table, "dbo") && AcceptSymbol(".")) {
            table.table = ExpectName();
        }
    }
    table.alias = ParseAlias();
    table.no_lock = ParseLockHint();
    return table;
}

bool Parser::ParseLockHint() {
    if (!AcceptKeyword(Keyword::kWith)) {
        return false;
    }
    ExpectSymbol("(");
    if (!AcceptWord("nolock")) {
        Fail("Not a known table hint", lexer_.Rest());
    }
    ExpectSymbol(")");
    return true;
}

bool Parser::ParseJoin(Select& select) {
    auto join = TableRef::Join::kInner;
    bool on = true;
    if (AcceptSymbol(",")) {
        on = false;
    } else if (AcceptKeyword(Keyword::kCross)) {
        Expect(Keyword::kJoin, "join");
        on = false;
    } else if (AcceptKeyword(Keyword::kLeft)) {
        join = TableRef::Join::kLeft;
        AcceptKeyword(Keyword::kOuter);
        Expect(Keyword::kJoin, "join");
    } else if (AcceptKeyword(Keyword::kInner)) {
        Expect(Keyword::kJoin, "join");
    } else if (!AcceptKeyword(Keyword::kJoin)) {
        return false;
    }
    TableRef table = ParseTable();
    table.join = join;
    if (on) {
        Expect(Keyword::kOn, "on");
        table.on = ParseOr();
    }
    select.from.push_back(std::move(table));
    return true;
}

std::vector<ExprPtr> Parser::ParseList() {
    std::vector<ExprPtr> list;
    do {
        list.push_back(ParseOr());
    } while (AcceptSymbol(","));
    return list;
}

std::vector<OrderItem> Parser::ParseOrder() {
    std::vector<OrderItem> order;
    do {
        OrderItem item{ParseOr()};
        if (!IsColumn(*item.expression)) {
            Fail("An order is columns or paths, separated by commas");
        }
        item.descending = AcceptKeyword(Keyword::kDesc);
        if (!item.descending) {
            AcceptKeyword(Keyword::kAsc);
        }
        order.push_back(std::move(item));
    } while (AcceptSymbol(","));
    return order;
}

}  // namespace zebtell::erp::sql
