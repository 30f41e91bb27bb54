#include "erp/sqlite/column_types.h"

#include <charconv>
#include <cmath>
#include <string>

#include "base/text.h"

namespace zebtell::erp::sqlite {
namespace {

struct DeclaredType {
    std::string_view name;
    ColumnType type;
};

constexpr DeclaredType kDeclaredTypes[] = {
    {"integer", ColumnType::kInteger},
    {"int", ColumnType::kInteger},
    {"bigint", ColumnType::kInteger},
    {"smallint", ColumnType::kInteger},
    {"money", ColumnType::kCurrency},
    {"decimal", ColumnType::kCurrency},
    {"currency", ColumnType::kCurrency},
    {"real", ColumnType::kDouble},
    {"float", ColumnType::kDouble},
    {"double", ColumnType::kDouble},
    {"numeric", ColumnType::kDouble},
    {"num", ColumnType::kDouble},
    {"bit", ColumnType::kBoolean},
    {"boolean", ColumnType::kBoolean},
    {"date", ColumnType::kDateTime},
    {"datetime", ColumnType::kDateTime},
};

// SQLite keeps whatever bytes an ERP has put into it; pages are sent as UTF-8.
std::string TextOf(sqlite3_stmt* statement, int column) {
    const auto* bytes = reinterpret_cast<const char*>(sqlite3_column_text(statement, column));
    std::string text(bytes ? bytes : "",
                     static_cast<std::size_t>(sqlite3_column_bytes(statement, column)));
    return base::Utf8FromEither(std::move(text));
}

// Amounts are stored as binary numbers; the nearest ten-thousandth is the one that was meant.
base::Currency CurrencyOf(double stored) {
    constexpr double kExact = 1e11;  // below, a double is nearer to its amount than to any other
    if (std::abs(stored) < kExact) {
        const double scaled = stored * base::Currency::kScale;
        const double nearest = std::nearbyint(scaled);
        if (std::abs(scaled - nearest) < 0.25) {
            return base::Currency::FromScaled(static_cast<std::int64_t>(nearest));
        }
    }
    return base::Currency::FromDouble(stored);
}

base::Value ReadDateTime(sqlite3_stmt* statement, int column) {
    std::string text = TextOf(statement, column);
    if (const auto time = base::DateTime::FromIso(text)) {
        return *time;
    }
    return text;
}

base::Value ReadStored(sqlite3_stmt* statement, int column, int storage) {
    switch (storage) {
        case SQLITE_INTEGER:
            return static_cast<std::int64_t>(sqlite3_column_int64(statement, column));
        case SQLITE_FLOAT:
            return sqlite3_column_double(statement, column);
        default:
            return TextOf(statement, column);
    }
}

}  // namespace

std::optional<ColumnType> TypeOf(std::string_view declared) {
    const std::string_view name = base::Trimmed(declared.substr(0, declared.find('(')));
    if (name.empty()) {
        return std::nullopt;
    }
    for (const DeclaredType& known : kDeclaredTypes) {
        if (base::EqualNoCase(known.name, name)) {
            return known.type;
        }
    }
    return ColumnType::kText;
}

int LengthOf(std::string_view declared) {
    const std::size_t open = declared.find('(');
    int length = 0;
    if (open != std::string_view::npos && TypeOf(declared) == ColumnType::kText) {
        std::from_chars(declared.data() + open + 1, declared.data() + declared.size(), length);
    }
    return length;
}

base::Value ReadColumn(sqlite3_stmt* statement, int column, std::optional<ColumnType> type) {
    const int storage = sqlite3_column_type(statement, column);
    if (storage == SQLITE_NULL) {
        return base::Value::Null();
    }
    const bool is_number = storage == SQLITE_INTEGER || storage == SQLITE_FLOAT;
    if (type == ColumnType::kText) {
        return TextOf(statement, column);
    }
    if (type == ColumnType::kDateTime) {
        return ReadDateTime(statement, column);
    }
    if (!type || !is_number) {
        return ReadStored(statement, column, storage);
    }
    switch (*type) {
        case ColumnType::kCurrency:
            return CurrencyOf(sqlite3_column_double(statement, column));
        case ColumnType::kDouble:
            return sqlite3_column_double(statement, column);
        case ColumnType::kBoolean:
            return sqlite3_column_int64(statement, column) != 0;
        default:
            return ReadStored(statement, column, storage);
    }
}

int BindValue(sqlite3_stmt* statement, int parameter, const base::Value& value) {
    if (value.IsEmpty() || value.IsNull()) {
        return sqlite3_bind_null(statement, parameter);
    }
    if (const auto* boolean = value.As<bool>()) {
        return sqlite3_bind_int(statement, parameter, *boolean ? 1 : 0);
    }
    if (const auto* integer = value.As<std::int64_t>()) {
        return sqlite3_bind_int64(statement, parameter, *integer);
    }
    if (const auto* number = value.As<double>()) {
        return sqlite3_bind_double(statement, parameter, *number);
    }
    if (const auto* amount = value.As<base::Currency>()) {
        return sqlite3_bind_double(statement, parameter, amount->ToDouble());
    }
    const std::string text = value.ToPlainText();
    return sqlite3_bind_text(
        statement, parameter, text.data(), static_cast<int>(text.size()), SQLITE_TRANSIENT);
}

}  // namespace zebtell::erp::sqlite
