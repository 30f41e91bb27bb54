#include "erp/sql/pieces.h"

#include <algorithm>
#include <iterator>

#include "base/text.h"
#include "erp/sql/errors.h"
#include "erp/sql/keywords.h"
#include "erp/sql/server_words.h"

namespace zebtell::erp::sql {
namespace {

constexpr std::size_t kLongestName = 128;

bool IsPlain(std::string_view name) {
    const auto is_letter = [](char c) {
        return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
    };
    return is_letter(name.front()) && KeywordOf(name) == Keyword::kNone &&
           !IsReservedOnServer(name) && std::all_of(name.begin(), name.end(), [&](char c) {
               return is_letter(c) || (c >= '0' && c <= '9');
           });
}

}  // namespace

void Append(BoundSql& out, BoundSql&& piece) {
    out.text += piece.text;
    if (out.values.empty()) {
        out.values = std::move(piece.values);
    } else {
        std::move(piece.values.begin(), piece.values.end(), std::back_inserter(out.values));
    }
}

void AppendValue(BoundSql& out, base::Value value) {
    out.text += '?';
    out.values.push_back(std::move(value));
}

void Prepend(BoundSql& piece, std::string_view text) {
    piece.text.insert(0, text);
}

std::string JsonList(std::span<const std::int64_t> numbers) {
    std::string json = "[";
    for (const std::int64_t number : numbers) {
        json.append(json.size() > 1 ? "," : "").append(std::to_string(number));
    }
    return json + "]";
}

void AppendName(BoundSql& out, std::string_view name, Dialect dialect) {
    if (name.empty() || name.size() > kLongestName) {
        Fail("Not a name", name);
    }
    if (IsPlain(name)) {
        out.text += name;
    } else if (dialect == Dialect::kSqlite) {
        out.text += '"' + base::Replaced(name, "\"", "\"\"") + '"';
    } else {
        out.text += '[' + base::Replaced(name, "]", "]]") + ']';
    }
}

void AppendTextLiteral(BoundSql& out, std::string_view text, Dialect dialect) {
    out.text += dialect == Dialect::kSqlite ? "'" : "N'";
    out.text += base::Replaced(text, "'", "''");
    out.text += '\'';
}

void AppendInJson(BoundSql& out, std::string json, Dialect dialect, bool as_text) {
    if (dialect == Dialect::kSqlite) {
        out.text += " in (select value from json_each(";
        AppendValue(out, std::move(json));
        out.text += "))";
        return;
    }
    // Texts made of numbers take the collation of what they are compared with.
    out.text += as_text ? " in (select cast(value as nvarchar(20))" : " in (select value";
    // Drivers send long texts as types that openjson does not take.
    out.text += " from openjson(cast(";
    AppendValue(out, std::move(json));
    out.text += " as nvarchar(max))) with (value bigint '$'))";
}

}  // namespace zebtell::erp::sql
