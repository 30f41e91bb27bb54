#include "erp/session.h"

#include <algorithm>

#include "base/runtime_error.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kMostQueryRows = 50'000;
constexpr std::size_t kFewRows = 1'000;

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

std::string KeyOf(const Reader& reader) {
    std::string key = reader.role == Role::kGuest ? "guest" : "user";
    const auto add = [&key](std::int64_t value) { key += " " + std::to_string(value); };
    for (const std::int64_t value : {reader.user,
                                     reader.partner,
                                     reader.settlement_company,
                                     reader.parent,
                                     reader.employee,
                                     reader.contact,
                                     reader.price_category}) {
        add(value);
    }
    std::for_each(reader.price_lists.begin(), reader.price_lists.end(), add);
    key += ",";
    std::for_each(reader.saved_documents.begin(), reader.saved_documents.end(), add);
    return key;
}

}  // namespace

Session::Session(std::shared_ptr<CompanyDatabase> database, Reader reader, base::Clock clock)
    : database_(std::move(database)),
      reader_(std::move(reader)),
      clock_(std::move(clock)),
      reader_key_(KeyOf(reader_)) {}

void Session::AddSavedDocument(std::int64_t id) {
    auto& saved = reader_.saved_documents;
    if (std::find(saved.begin(), saved.end(), id) != saved.end()) {
        return;
    }
    saved.push_back(id);
    reader_key_ = KeyOf(reader_);
}

// The result of that key since the database changed last, else what `read` gives.
template <class Kept, class Read>
std::shared_ptr<const Kept> Session::Shared(const std::string& key, Read&& read) {
    const std::int64_t version = database_->pool().DataVersion();
    if (auto kept = database_->results().Find(key, version)) {
        return std::static_pointer_cast<const Kept>(std::move(kept));
    }
    std::shared_ptr<const Kept> result = read();
    database_->results().Keep(key, version, result);
    return result;
}

template <class Read>
auto Session::Run(const BoundSql& sql, Read&& read) {
    return database_->pool().Reading([&](Connection& connection) {
        const auto cursor = connection.Query(sql);
        return read(*cursor);
    });
}

// Named users and guests may read different columns.
std::string Session::TableKey(const TableInfo& table) const {
    return (reader_.role == Role::kGuest ? "guest " : "user ") + table.name;
}

std::shared_ptr<const KeyTable> Session::Keys(const TableInfo& table,
                                              const data::Filter& filter,
                                              std::string_view order,
                                              std::string_view find_column) {
    LearnedFields& learned = database_->find_columns();
    const std::string key = TableKey(table);
    const auto known = learned.Of(key, [] { return std::vector<std::string>(); });
    const auto linked = FindLinkedOrder(schema(), table, order);
    auto fields = With(known, find_column);
    if (linked) {
        fields = With(std::move(fields), linked->link->name);
    }
    const std::vector<std::string> columns(Selected(*fields).begin(), Selected(*fields).end());
    const BoundSql sql =
        database_->translator().ListKeys(reader_, table.name, filter, linked ? "" : order, columns);
    const std::string by_link = linked ? "by " + linked->link->name + " " + linked->order : "";
    auto keys = Shared<KeyTable>(ResultKey('k', sql) + by_link, [&] {
        const auto read = ReadKeys(sql, columns);
        return linked ? InOrder(read, *linked) : read;
    });
    if (fields != known) {
        learned.Learn(key, fields);
    }
    return keys;
}

std::shared_ptr<const KeyTable> Session::ReadKeys(const BoundSql& sql,
                                                  const std::vector<std::string>& columns) {
    return Run(sql,
               [&](Cursor& cursor) { return std::make_shared<const KeyTable>(cursor, columns); });
}

// The order of all linked records is read once for all lists; for a short list that of its own.
std::shared_ptr<const KeyTable> Session::InOrder(const std::shared_ptr<const KeyTable>& keys,
                                                 const LinkedOrder& order) {
    const std::size_t link = *keys->ColumnOf(order.link->name);
    std::string filter;
    if (keys->count() <= kFewRows) {
        filter = "ID in (0";
        for (std::size_t row = 0; row < keys->count(); ++row) {
            filter += "," + std::to_string(keys->Get(row, link));
        }
        filter += ")";
    }
    const auto linked = Keys(*order.target, filter, order.order);
    return ArrangedByLink(*keys, link, *linked, order.descending);
}

std::shared_ptr<const RowSet> Session::Rows(const TableInfo& table,
                                            std::span<const std::int64_t> ids,
                                            std::string_view field) {
    LearnedFields& learned = database_->fields();
    const std::string key = TableKey(table);
    const auto known = learned.Of(
        key, [&] { return database_->translator().ReadableColumns(reader_, table.name); });
    const auto fields = With(known, field);
    const BoundSql sql =
        database_->translator().RowsByID(reader_, table.name, ids, Selected(*fields));
    auto rows = Shared<RowSet>(ResultKey('r', sql), [&] {
        return Run(sql,
                   [&](Cursor& cursor) { return RowSet::Arranged(*ReadAll(cursor, fields), ids); });
    });
    if (fields != known) {
        learned.Learn(key, fields);
    }
    return rows;
}

// Known by its text as it was written, since taking that apart costs more than an unchanged page.
std::shared_ptr<const RowSet> Session::Query(std::string_view sql) {
    return Shared<RowSet>("q" + reader_key_ + "\n" + std::string(sql), [&] {
        return Run(database_->translator().Select(reader_, sql), [](Cursor& cursor) {
            return ReadAll(cursor, std::make_shared<const FieldSet>(cursor.Columns()));
        });
    });
}

}  // namespace zebtell::erp
