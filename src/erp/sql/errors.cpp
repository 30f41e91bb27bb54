#include "erp/sql/errors.h"

#include <string>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::erp::sql {
namespace {

constexpr std::size_t kShownCharacters = 40;

std::string Escaped(char byte) {
    switch (byte) {
        case '&':
            return "&amp;";
        case '<':
            return "&lt;";
        case '>':
            return "&gt;";
        case '"':
            return "&quot;";
        case '\'':
            return "&#39;";
        default:
            return std::string(1, byte);
    }
}

std::string Shown(std::string_view text) {
    std::string shown;
    for (const char byte : base::WithoutControls(base::FirstCharacters(text, kShownCharacters))) {
        shown += Escaped(byte);
    }
    return shown;
}

}  // namespace

void Fail(std::string_view what, std::string_view where) {
    std::string description(what);
    if (!where.empty()) {
        description += ": " + Shown(where);
    }
    throw base::RuntimeError(base::errors::kStatementFailed, description);
}

void FailNoTable(std::string_view table) {
    throw base::RuntimeError(base::errors::kNoSuchTable, "No such table: " + Shown(table));
}

}  // namespace zebtell::erp::sql
