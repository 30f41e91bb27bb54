#include "tags/reference.h"

#include <algorithm>
#include <iomanip>

namespace zebtell::tags {

void PrintReference(std::ostream& out, std::string_view title, const TagTable& table) {
    std::size_t width = 0;
    for (const TagRow& row : table.rows()) width = std::max(width, row.name.size());
    out << title << '\n';
    for (const TagRow& row : table.rows()) {
        out << "  " << std::left << std::setw(static_cast<int>(width)) << row.name << "  "
            << row.help << '\n';
    }
}

}  // namespace zebtell::tags
