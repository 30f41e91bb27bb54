#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace zebtell::orders {

// One line of the quick entry as it was typed.
struct QuickEntryLine {
    std::string code;
    std::string quantity;
};

// Lines of code and quantity, parted as a spreadsheet parts its cells (tab), by a semicolon, or by
// blanks before the last word. Of more than two cells the first and the last count; a code alone,
// as a scanner types it, means one. Empty lines do not count.
std::vector<QuickEntryLine> ReadQuickEntry(std::string_view text);

}  // namespace zebtell::orders
