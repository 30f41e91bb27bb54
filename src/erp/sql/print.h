#pragma once

#include <string_view>
#include <vector>

#include "erp/sql/ast.h"
#include "erp/sql/lexer.h"
#include "erp/sql/names.h"
#include "erp/sql/pieces.h"

namespace zebtell::erp::sql {

// What printing one statement needs. Trees are written as SQL of one database, for one reader.
// Every table stands for the rows that the reader may read: their condition is part of the select's
// "where" or of the join's "on". Literals become values.
struct Context {
    Context(const Schema& schema, Dialect dialect, const Reader& reader, Style style)
        : dialect(dialect), reader(reader), style(style), names(schema, reader.role) {}

    const Dialect dialect;
    const Reader& reader;
    const Style style;
    Names names;
    Joins* children = nullptr;     // child tables of the condition being printed
    bool unlimited = false;        // within a text of the access policy
    bool inline_literals = false;  // where the databases compare expressions with one another
    bool in_pattern = false;       // of "like"
};

// Sets a variable for as long as it lives.
template <class T>
class Temporarily {
  public:
    Temporarily(T& variable, T value) : variable_(variable), before_(variable) {
        variable_ = value;
    }
    ~Temporarily() { variable_ = before_; }
    Temporarily(const Temporarily&) = delete;
    Temporarily& operator=(const Temporarily&) = delete;

  private:
    T& variable_;
    T before_;
};

// Values give their type. An operand is put in parentheses where operators around it would tear it
// apart.
ValueType PrintValue(Context& context, const Expr& value, Scope& scope, BoundSql& out);
ValueType PrintOperand(Context& context, const Expr& value, Scope& scope, BoundSql& out);
ValueType PrintChain(Context& context, const Chain& chain, Scope& scope, BoundSql& out);
ValueType PrintCall(Context& context, const Call& call, Scope& scope, BoundSql& out);
ValueType PrintCast(Context& context, const Cast& cast, Scope& scope, BoundSql& out);

// A value where a condition belongs, such as a flag, stands for "is not 0".
void PrintCondition(Context& context, const Expr& condition, Scope& scope, BoundSql& out);
// The same as a part of "and", in parentheses where it is an "or".
void PrintAndPart(Context& context, const Expr& condition, Scope& scope, BoundSql& out);
// Comparisons, "like", "in", "between" and "is null"; whether it was one of these.
bool TryPrintPredicate(Context& context, const Expr& condition, Scope& scope, BoundSql& out);

// The rows that a statement gives, those that it joins, and the values of "in", "exists" or a
// single value.
enum class SelectUse { kResult, kRows, kValues };
std::vector<OutputColumn> PrintSelect(
    Context& context, const Select& select, Scope* outer, SelectUse use, BoundSql& out);

// Tables: "GRArticle t2", "t2.Code", the joins that paths have added, and the condition on the rows
// of a source behind `glue` (whether there is one).
void PrintTable(const Context& context, const Source& source, BoundSql& out);
void PrintColumn(const Context& context, const ResolvedColumn& column, BoundSql& out);
void PrintLinks(Context& context, const Joins& joins, BoundSql& out);
bool PrintRowScope(Context& context, Source& source, std::string_view glue, BoundSql& out);
// "exists (select 1 from the children where `condition`)"
void PrintChildren(Context& context, const Joins& children, BoundSql&& condition, BoundSql& out);

}  // namespace zebtell::erp::sql
