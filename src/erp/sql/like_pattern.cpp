#include "erp/sql/like_pattern.h"

namespace zebtell::erp::sql {

std::string LikePattern(std::string_view pattern, Style style, Dialect dialect) {
    const bool filter = style == Style::kFilter;
    std::string result;
    result.reserve(pattern.size() + 2);
    char before = '\0';
    for (const char c : pattern) {
        const bool repeated = c == before;
        before = c;
        if (filter && c == '*') {
            result += repeated ? "" : "%";
            continue;
        }
        if (filter && c == '?') {
            result += '_';
            continue;
        }
        // SQL Server's classes in brackets are no part of the language.
        if (c == '\\' || (filter && (c == '%' || c == '_')) ||
            (c == '[' && dialect == Dialect::kSqlServer)) {
            result += '\\';
        }
        result += c;
    }
    return result;
}

}  // namespace zebtell::erp::sql
