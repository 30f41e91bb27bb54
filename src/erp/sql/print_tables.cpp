#include "erp/sql/policy_scopes.h"
#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

void PrintStep(const Context& context, const Source& source, BoundSql& out) {
    PrintColumn(context, {&source, source.own_column, ValueType::kNumber}, out);
    out.text += " = ";
    PrintColumn(context, {source.parent, source.parent_column, ValueType::kNumber}, out);
}

void PrintJoin(Context& context, Source& source, BoundSql& out) {
    out.text += source.kind == Source::Kind::kLink ? " left join " : " inner join ";
    PrintTable(context, source, out);
    out.text += " on ";
    PrintStep(context, source, out);
    PrintRowScope(context, source, " and ", out);
}

}  // namespace

void PrintTable(const Context& context, const Source& source, BoundSql& out) {
    AppendName(out, source.table->name, context.dialect);
    out.text.append(" ").append(source.alias);
}

void PrintColumn(const Context& context, const ResolvedColumn& column, BoundSql& out) {
    out.text.append(column.source->alias).append(".");
    AppendName(out, column.name, context.dialect);
}

void PrintLinks(Context& context, const Joins& joins, BoundSql& out) {
    for (Source* source : joins.tables) {
        PrintJoin(context, *source, out);
    }
}

// The policy's own texts name tables that nothing limits: they say what is the reader's.
bool PrintRowScope(Context& context, Source& source, std::string_view glue, BoundSql& out) {
    const Expr* row_scope = source.rule ? RowScope(*source.rule, context.reader.role) : nullptr;
    if (!row_scope) {
        return false;
    }
    const Temporarily<bool> unlimited(context.unlimited, true);
    const Temporarily<Joins*> children(context.children, nullptr);
    Scope scope;
    scope.sources.push_back(&source);
    out.text += glue;
    PrintAndPart(context, *row_scope, scope, out);
    return true;
}

void PrintChildren(Context& context, const Joins& children, BoundSql&& condition, BoundSql& out) {
    Source& first = *children.tables.front();
    out.text += "exists (select 1 from ";
    PrintTable(context, first, out);
    for (std::size_t i = 1; i < children.tables.size(); ++i) {
        PrintJoin(context, *children.tables[i], out);
    }
    out.text += " where ";
    PrintStep(context, first, out);
    PrintRowScope(context, first, " and ", out);
    out.text += " and ";
    Append(out, std::move(condition));
    out.text += ')';
}

}  // namespace zebtell::erp::sql
