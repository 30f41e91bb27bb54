#include "erp/sql/like_pattern.h"

namespace zebtell::erp::sql {

std::string LikePattern(std::string_view pattern, Style style, Dialect dialect) {
    const bool filter = style == Style::kFilter;
    std::string result;
    result.reserve(pattern.size() + 2);
    for (const char c : pattern) {
        if (filter && c == '*') {
            if (result.empty() || result.back() != '%') {
                result += '%';
            }
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
