#include "erp/record_fields.h"

#include <algorithm>

#include "base/region.h"
#include "base/runtime_error.h"
#include "erp/access.h"
#include "erp/read_only_record.h"

namespace zebtell::erp {
namespace {

constexpr double kLargest = 1e9;

bool Names(const std::vector<std::string_view>& columns, std::string_view name) {
    return std::any_of(columns.begin(), columns.end(), [name](std::string_view column) {
        return base::EqualNoCase(column, name);
    });
}

bool IsHidden(const TableInfo& table, std::string_view column) {
    const AccessRule* rule = FindAccessRule(table.name);
    return !rule || Names(rule->hidden_columns, column);
}

[[noreturn]] void Refuse(const Column& column, const char* why) {
    throw base::RuntimeError(base::errors::kInvalidCall, column.name + " " + why);
}

base::Value AcceptedText(Session& session,
                         const TableInfo& table,
                         const Column& column,
                         const base::Value& value) {
    std::string text = value.ToPlainText();
    const int longest = session.database().MaxLength(table.name, column.name);
    if (longest > 0 && base::CharacterCount(text) > static_cast<std::size_t>(longest)) {
        Refuse(column, ("is longer than " + std::to_string(longest) + " characters").c_str());
    }
    return text;
}

base::Value AcceptedLink(Session& session, const Column& column, const base::Value& value) {
    const std::int64_t id = value.ToInteger64();
    const TableInfo& target = session.database().Table(column.links_to);
    if (!session.Rows(target, std::span(&id, 1))->Has(0)) {
        Refuse(column, "names a record that is not there");
    }
    return id;
}

// Dates that are not ISO are taken in the portal's own order, day first.
base::Value AcceptedDate(const base::Value& value) {
    const auto* text = value.As<std::string>();
    const auto iso = text ? base::DateTime::FromIso(base::Trimmed(*text)) : std::nullopt;
    return iso ? *iso : value.ToDateTime(base::RegionFor("et"));
}

template <class Number>
base::Value InRange(const Column& column, const Number& number, double size) {
    if (!(size >= 0)) {
        Refuse(column, "can't be negative");
    }
    if (size > kLargest) {
        Refuse(column, "is too large");
    }
    return number;
}

}  // namespace

RecordFields::RecordFields(const TableInfo& table) : table_(&table) {
    for (const Column& column : table.columns) {
        values_.push_back(column.type == ColumnType::kText ? base::Value("") : base::Value::Null());
    }
}

std::size_t RecordFields::IndexOf(std::string_view column) const {
    const Column* found = table_->FindColumn(column);
    if (!found) {
        NoSuchField(column);
    }
    return static_cast<std::size_t>(found - table_->columns.data());
}

const base::Value* RecordFields::Find(std::string_view name) const {
    static const base::Value kUnset;
    if (name.starts_with('@')) {
        const auto found = extras_.find(name);
        return found == extras_.end() ? &kUnset : &found->second;
    }
    if (!table_->FindColumn(name) || IsHidden(*table_, name)) {
        return nullptr;
    }
    return &values_[IndexOf(name)];
}

const base::Value& RecordFields::Get(std::string_view column) const {
    return values_[IndexOf(column)];
}

base::Currency RecordFields::Money(std::string_view column) const {
    const base::Value& value = Get(column);
    return value.IsNull() ? base::Currency() : value.ToCurrency();
}

double RecordFields::Number(std::string_view column) const {
    const base::Value& value = Get(column);
    return value.IsNull() ? 0 : value.ToDouble();
}

std::int64_t RecordFields::Integer(std::string_view column) const {
    const base::Value& value = Get(column);
    return value.IsNull() ? 0 : value.ToInteger64();
}

void RecordFields::Set(std::string_view name, base::Value value) {
    if (name.starts_with('@')) {
        extras_.insert_or_assign(std::string(name), std::move(value));
    } else {
        values_[IndexOf(name)] = std::move(value);
    }
}

void RecordFields::Take(const RowSet& rows, std::size_t row) {
    for (std::size_t i = 0; i < values_.size(); ++i) {
        const auto field = rows.fields().Find(table_->columns[i].name);
        const bool is_text = table_->columns[i].type == ColumnType::kText;
        if (field && !(is_text && rows.Get(row, *field).IsNull())) {
            values_[i] = rows.Get(row, *field);
        }
    }
}

const Column& WritableColumn(const TableInfo& table, std::string_view name) {
    const Column* column = table.FindColumn(name);
    if (!column || IsHidden(table, name)) {
        NoSuchField(name);
    }
    const AccessRule* rule = FindAccessRule(table.name);
    if (!Names(rule->writable_columns, name)) {
        Refuse(*column, "can't be changed");
    }
    return *column;
}

base::Value Accepted(Session& session,
                     const TableInfo& table,
                     const Column& column,
                     const base::Value& value) {
    if (column.type == ColumnType::kText) {
        return AcceptedText(session, table, column, value.IsBlank() ? base::Value("") : value);
    }
    if (value.IsBlank()) {
        return base::Value::Null();
    }
    if (!column.links_to.empty()) {
        return AcceptedLink(session, column, value);
    }
    switch (column.type) {
        case ColumnType::kCurrency:
            return InRange(column, value.ToCurrency(), value.ToDouble());
        case ColumnType::kDouble:
            return InRange(column, value.ToDouble(), value.ToDouble());
        case ColumnType::kDateTime:
            return AcceptedDate(value);
        case ColumnType::kBoolean:
            return value.ToBoolean();
        default:
            return value.ToInteger64();
    }
}

}  // namespace zebtell::erp
