#include <algorithm>

#include "erp/sql/errors.h"
#include "erp/sql/print.h"

namespace zebtell::erp::sql {
namespace {

// Prints one select. Its tables come first, since they say what the names mean, and are written
// last, since paths add to them.
class SelectPrinter {
  public:
    SelectPrinter(Context& context, const Select& select, Scope* outer, SelectUse use)
        : context_(context), select_(select), use_(use) {
        scope_.outer = outer;
    }

    std::vector<OutputColumn> Print(BoundSql& out) {
        PrintFrom();
        {
            const bool grouped = !select_.group.empty() || select_.distinct;
            const Temporarily<bool> literals(context_.inline_literals,
                                             context_.inline_literals || grouped);
            PrintItems();
            PrintGroup();
            PrintOrder();
        }
        PrintWhere();
        Assemble(out);
        return std::move(columns_);
    }

  private:
    void PrintFrom() {
        scope_.links_allowed = false;
        for (const TableRef& table : select_.from) {
            if (table.join != TableRef::Join::kFirst) {
                from_.text += table.join == TableRef::Join::kLeft ? " left join " : " inner join ";
            }
            Source& source = PrintSource(table);
            if (table.join != TableRef::Join::kFirst) {
                PrintOn(table, source);
            }
        }
        scope_.links_allowed = true;
    }

    Source& PrintSource(const TableRef& table) {
        Source* source = nullptr;
        if (table.subquery) {
            from_.text += '(';
            source = &context_.names.OpenSubquery(
                PrintSelect(context_, *table.subquery, scope_.outer, SelectUse::kRows, from_));
            from_.text.append(") ").append(source->alias);
        } else {
            source = context_.unlimited ? &context_.names.OpenUnlimited(table.table)
                                        : &context_.names.Open(table.table);
            PrintTable(context_, *source, from_);
        }
        if (table.no_lock && !table.subquery && context_.dialect == Dialect::kSqlServer) {
            from_.text += " with (nolock)";
        }
        const std::string_view name = table.alias.empty() ? table.table : table.alias;
        if (name.empty()) {
            Fail("A subquery needs a name");
        }
        context_.names.Add(*source, name, scope_);
        return *source;
    }

    void PrintOn(const TableRef& table, Source& source) {
        from_.text += " on ";
        if (table.on) {
            PrintAndPart(context_, *table.on, scope_, from_);
        } else {
            from_.text += "1 = 1";
        }
        PrintRowScope(context_, source, " and ", from_);
    }

    void PrintItems() {
        for (const Item& item : select_.items) {
            if (item.star) {
                PrintStar(item);
            } else {
                PrintItem(item);
            }
        }
        if (columns_.empty()) {
            Fail("No such table here", select_.items.front().star_of);
        }
    }

    void PrintStar(const Item& item) {
        const std::size_t before = columns_.size();
        for (const Source* source : scope_.sources) {
            if (!item.star_of.empty() && !base::EqualNoCase(source->name, item.star_of)) {
                continue;
            }
            for (const ResolvedColumn& column : Names::ReadableColumns(*source)) {
                items_.text += columns_.empty() ? "" : ", ";
                PrintColumn(context_, column, items_);
                AddColumn({std::string(column.name), column.type});
            }
        }
        if (columns_.size() == before) {
            Fail("No such table here", item.star_of);
        }
    }

    void PrintItem(const Item& item) {
        items_.text += columns_.empty() ? "" : ", ";
        const auto* path = std::get_if<Path>(&item.expression->node);
        OutputColumn column;
        if (path) {
            const auto resolved = context_.names.Resolve(*path, scope_, nullptr);
            PrintColumn(context_, resolved, items_);
            column = {std::string(resolved.name), resolved.type};
        } else {
            column = {"Column" + std::to_string(columns_.size() + 1),
                      PrintValue(context_, *item.expression, scope_, items_)};
        }
        if (!item.alias.empty()) {
            column.name = item.alias;
        }
        AddColumn(std::move(column));
    }

    // Columns are named wherever something reads them by name.
    void AddColumn(OutputColumn column) {
        if (use_ != SelectUse::kValues) {
            items_.text += " as ";
            AppendName(items_, column.name, context_.dialect);
        }
        columns_.push_back(std::move(column));
    }

    void PrintGroup() {
        std::string_view glue = " group by ";
        for (const ExprPtr& expression : select_.group) {
            group_.text += glue;
            PrintValue(context_, *expression, scope_, group_);
            glue = ", ";
        }
        if (select_.having) {
            group_.text += " having ";
            PrintCondition(context_, *select_.having, scope_, group_);
        }
    }

    // The order of a subquery means nothing unless it says which rows are the first.
    void PrintOrder() {
        if (use_ != SelectUse::kResult && !select_.top) {
            return;
        }
        std::vector<std::string> ordered;
        for (const OrderItem& item : select_.order) {
            BoundSql value;
            PrintOrderValue(*item.expression, value);
            // SQL Server refuses a column that stands there again.
            if (std::find(ordered.begin(), ordered.end(), value.text) != ordered.end() &&
                value.values.empty()) {
                continue;
            }
            order_.text += ordered.empty() ? " order by " : ", ";
            ordered.push_back(value.text);
            Append(order_, std::move(value));
            order_.text += item.descending ? " desc" : "";
        }
    }

    void PrintOrderValue(const Expr& value, BoundSql& out) {
        const auto* literal = std::get_if<Literal>(&value.node);
        if (literal) {
            const auto* position = literal->value.As<std::int64_t>();
            if (!position || *position < 1 ||
                *position > static_cast<std::int64_t>(columns_.size())) {
                Fail("Not a column to order by");
            }
            out.text += std::to_string(*position);
        } else if (!PrintOutputName(value, out)) {
            PrintValue(context_, value, scope_, out);
        }
    }

    // A name that the select gives to one of its columns goes before those of the tables.
    bool PrintOutputName(const Expr& value, BoundSql& out) {
        const auto* path = std::get_if<Path>(&value.node);
        if (!path || path->parts.size() != 1) {
            return false;
        }
        for (std::size_t i = 0; i < select_.items.size(); ++i) {
            if (base::EqualNoCase(select_.items[i].alias, path->parts.front())) {
                if (use_ == SelectUse::kValues) {
                    PrintValue(context_, *select_.items[i].expression, scope_, out);
                } else {
                    AppendName(out, select_.items[i].alias, context_.dialect);
                }
                return true;
            }
        }
        return false;
    }

    void PrintWhere() {
        std::string_view glue = " where ";
        if (PrintRowScope(context_, *scope_.sources.front(), glue, where_)) {
            glue = " and ";
        }
        if (select_.where) {
            where_.text += glue;
            PrintAndPart(context_, *select_.where, scope_, where_);
        }
    }

    void Assemble(BoundSql& out) {
        out.text += select_.distinct ? "select distinct " : "select ";
        const std::string top = select_.top ? std::to_string(*select_.top) : "";
        if (select_.top && context_.dialect == Dialect::kSqlServer) {
            out.text += "top (" + top + ") ";
        }
        Append(out, std::move(items_));
        out.text += " from ";
        Append(out, std::move(from_));
        PrintLinks(context_, scope_.joins, out);
        Append(out, std::move(where_));
        Append(out, std::move(group_));
        Append(out, std::move(order_));
        if (select_.top && context_.dialect == Dialect::kSqlite) {
            out.text += " limit " + top;
        }
    }

    Context& context_;
    const Select& select_;
    const SelectUse use_;
    Scope scope_;
    std::vector<OutputColumn> columns_;
    BoundSql from_;
    BoundSql items_;
    BoundSql where_;
    BoundSql group_;
    BoundSql order_;
};

}  // namespace

std::vector<OutputColumn> PrintSelect(
    Context& context, const Select& select, Scope* outer, SelectUse use, BoundSql& out) {
    const Temporarily<Joins*> children(context.children, nullptr);
    const Temporarily<bool> in_pattern(context.in_pattern, false);
    return SelectPrinter(context, select, outer, use).Print(out);
}

}  // namespace zebtell::erp::sql
