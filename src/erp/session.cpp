#include "erp/session.h"

#include "base/runtime_error.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kMostQueryRows = 50'000;

std::shared_ptr<RowSet> ReadAll(Cursor& cursor, std::shared_ptr<const FieldSet> fields) {
    auto rows = std::make_shared<RowSet>(std::move(fields));
    while (cursor.Next()) {
        if (rows->count() == kMostQueryRows) {
            throw base::RuntimeError(base::errors::kStatementFailed,
                                     "The statement gives too many rows");
        }
        rows->Append(cursor);
    }
    return rows;
}

std::shared_ptr<const FieldSet> With(std::shared_ptr<const FieldSet> fields,
                                     std::string_view field) {
    if (field.empty() || fields->Find(field)) {
        return fields;
    }
    std::vector<std::string> names = fields->names();
    names.emplace_back(field);
    return std::make_shared<const FieldSet>(std::move(names));
}

// All but the key, which statements by key select anyhow.
std::span<const std::string> Selected(const FieldSet& fields) {
    return std::span(fields.names()).subspan(1);
}

}  // namespace

// The result of an equal statement since the database changed last, else what `read` makes of it.
template <class Read>
auto Session::Shared(char kind, const BoundSql& sql, Read&& read) {
    const std::string key = ResultKey(kind, sql);
    const std::int64_t version = database_->pool().DataVersion();
    using Kept = decltype(read(std::declval<Cursor&>()));
    if (auto kept = database_->results().Find(key, version)) {
        return std::static_pointer_cast<typename Kept::element_type>(kept);
    }
    const Lease connection = database_->pool().Read();
    const auto cursor = connection->Query(sql);
    Kept result = read(*cursor);
    database_->results().Keep(key, version, result);
    return result;
}

// Named users and guests may read different columns.
std::string Session::ReaderKey(const TableInfo& table) const {
    return (reader_.role == Role::kGuest ? "guest " : "user ") + table.name;
}

std::shared_ptr<const KeyTable> Session::Keys(const TableInfo& table,
                                              std::string_view filter,
                                              std::string_view order,
                                              std::string_view find_column) {
    LearnedFields& learned = database_->find_columns();
    const std::string key = ReaderKey(table);
    const auto known = learned.Of(key, [] { return std::vector<std::string>(); });
    const auto fields = With(known, find_column);
    const std::vector<std::string> columns(Selected(*fields).begin(), Selected(*fields).end());
    const BoundSql sql =
        database_->translator().ListKeys(reader_, table.name, filter, order, columns);
    auto keys = Shared('k', sql, [&](Cursor& cursor) {
        return std::make_shared<const KeyTable>(cursor, columns);
    });
    if (fields != known) {
        learned.Learn(key, fields);
    }
    return keys;
}

std::shared_ptr<const RowSet> Session::Rows(const TableInfo& table,
                                            std::span<const std::int64_t> ids,
                                            std::string_view field) {
    LearnedFields& learned = database_->fields();
    const std::string key = ReaderKey(table);
    const auto known = learned.Of(
        key, [&] { return database_->translator().ReadableColumns(reader_, table.name); });
    const auto fields = With(known, field);
    const BoundSql sql =
        database_->translator().RowsByID(reader_, table.name, ids, Selected(*fields));
    auto rows = Shared(
        'r', sql, [&](Cursor& cursor) { return RowSet::Arranged(*ReadAll(cursor, fields), ids); });
    if (fields != known) {
        learned.Learn(key, fields);
    }
    return rows;
}

std::shared_ptr<const RowSet> Session::Query(std::string_view sql) {
    const BoundSql bound = database_->translator().Select(reader_, sql);
    return Shared('q', bound, [](Cursor& cursor) -> std::shared_ptr<const RowSet> {
        return ReadAll(cursor, std::make_shared<const FieldSet>(cursor.Columns()));
    });
}

}  // namespace zebtell::erp
