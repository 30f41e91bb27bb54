#include "erp/translator.h"

#include <algorithm>
#include <utility>

#include "base/text.h"
#include "erp/made_for.h"
#include "erp/sql/errors.h"
#include "erp/sql/narrow.h"
#include "erp/sql/parser.h"
#include "erp/sql/print.h"

namespace zebtell::erp {
namespace {

using sql::Context;
using sql::Style;

// The condition of a filter, with blanks for the braces that mark it as SQL; empty when there is
// none.
std::string ConditionOf(std::string filter) {
    constexpr std::string_view kBlanks = " \t\r\n";
    const std::size_t begin = filter.find_first_not_of(kBlanks);
    if (begin == std::string::npos) {
        return {};
    }
    if (filter[begin] == '{') {
        const std::size_t end = filter.find_last_not_of(kBlanks);
        if (filter[end] != '}') {
            sql::Fail("The closing brace is missing", filter);
        }
        filter[begin] = filter[end] = ' ';
    }
    return filter;
}

sql::Path PathOf(std::string_view dotted) {
    if (dotted.empty()) {
        sql::Fail("The name of a field is missing");
    }
    return {base::Split(dotted, '.')};
}

// A select of the key and fields of one table.
class TableSelect {
  public:
    TableSelect(const Schema& schema, Dialect dialect, const Reader& reader, std::string_view table)
        : context_(schema, dialect, reader, Style::kFilter), source_(context_.names.Open(table)) {
        context_.names.Add(source_, source_.table->name, scope_);
        items_.text = "select ";
        AddField("ID");
        if (sql::PrintRowScope(context_, source_, " where ", where_)) {
            glue_ = " and ";
        }
    }

    void AddFields(std::span<const std::string> fields) {
        for (const std::string& field : fields) {
            items_.text += ", ";
            AddField(field);
        }
    }

    void AddCondition(const data::Filter& filter) {
        const std::string condition = ConditionOf(filter.text());
        if (!base::Trimmed(condition).empty()) {
            const sql::ExprPtr parsed =
                sql::Parser(condition, Style::kFilter, filter.typed()).ParseCondition();
            where_.text += NextGlue();
            sql::PrintAndPart(context_, *parsed, scope_, where_);
        }
    }

    void AddIDs(std::span<const std::int64_t> ids) {
        where_.text += NextGlue();
        PrintPath(PathOf("ID"), where_);
        sql::AppendInJson(where_, sql::JsonList(ids), context_.dialect, false);
    }

    // By the key at last, so that the order is always the same.
    void AddOrder(std::string_view order) {
        if (!order.empty()) {
            for (const sql::OrderItem& item : sql::Parser(order, Style::kFilter).ParseOrderList()) {
                AddOrderItem(item);
            }
        }
        AddOrderPath(PathOf("ID"), false);
    }

    BoundSql Statement() {
        BoundSql out = std::move(items_);
        out.text += " from ";
        sql::PrintTable(context_, source_, out);
        sql::PrintLinks(context_, scope_.joins, out);
        sql::Append(out, std::move(where_));
        sql::Append(out, std::move(order_));
        return out;
    }

  private:
    void AddField(std::string_view field) { PrintPath(PathOf(field), items_); }

    std::string_view NextGlue() { return std::exchange(glue_, " and "); }

    void PrintPath(const sql::Path& path, BoundSql& out) {
        sql::PrintColumn(context_, context_.names.Resolve(path, scope_, nullptr), out);
    }

    void AddOrderItem(const sql::OrderItem& item) {
        const auto* path = std::get_if<sql::Path>(&item.expression->node);
        if (!path) {
            sql::Fail("An order is columns or paths, separated by commas");
        }
        AddOrderPath(*path, item.descending);
    }

    // A column that stands there again means nothing, and SQL Server refuses it.
    void AddOrderPath(const sql::Path& path, bool descending) {
        BoundSql column;
        PrintPath(path, column);
        if (std::find(ordered_.begin(), ordered_.end(), column.text) != ordered_.end()) {
            return;
        }
        order_.text += ordered_.empty() ? " order by " : ", ";
        order_.text += column.text + (descending ? " desc" : "");
        ordered_.push_back(std::move(column.text));
    }

    Context context_;
    sql::Scope scope_;
    sql::Source& source_;
    BoundSql items_;
    BoundSql where_;
    BoundSql order_;
    std::vector<std::string> ordered_;  // the columns in order_
    std::string_view glue_ = " where ";
};

}  // namespace

BoundSql Translator::ListKeys(const Reader& reader,
                              std::string_view table,
                              const data::Filter& filter,
                              std::string_view order,
                              std::span<const std::string> columns) const {
    return MadeFor(dialect_, [&](Dialect dialect) {
        TableSelect select(schema_, dialect, reader, table);
        select.AddFields(columns);
        select.AddCondition(filter);
        select.AddOrder(base::Trimmed(order));
        return select.Statement();
    });
}

BoundSql Translator::RowsByID(const Reader& reader,
                              std::string_view table,
                              std::span<const std::int64_t> ids,
                              std::span<const std::string> fields) const {
    return MadeFor(dialect_, [&](Dialect dialect) {
        TableSelect select(schema_, dialect, reader, table);
        select.AddFields(fields);
        select.AddIDs(ids);
        return select.Statement();
    });
}

BoundSql Translator::Select(const Reader& reader, std::string_view sql) const {
    const sql::SelectPtr select = sql::Parser(sql, Style::kStatement).ParseStatement();
    sql::NarrowSubqueries(*select);
    return MadeFor(dialect_, [&](Dialect dialect) {
        Context context(schema_, dialect, reader, Style::kStatement);
        BoundSql out;
        sql::PrintSelect(context, *select, nullptr, sql::SelectUse::kResult, out);
        return out;
    });
}

std::vector<std::string> Translator::ReadableColumns(const Reader& reader,
                                                     std::string_view table) const {
    sql::Names names(schema_, reader.role);
    std::vector<std::string> columns;
    for (const auto& column : sql::Names::ReadableColumns(names.Open(table))) {
        columns.emplace_back(column.name);
    }
    return columns;
}

}  // namespace zebtell::erp
