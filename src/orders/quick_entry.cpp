#include "orders/quick_entry.h"

#include "base/text.h"
#include "tags/custom_func.h"

namespace zebtell::orders {
namespace {

constexpr std::string_view kOne = "1";

QuickEntryLine Parted(std::string_view line, std::size_t code_end, std::size_t quantity_start) {
    std::string quantity = tags::CleanFormValue(line.substr(quantity_start));
    if (quantity.empty()) quantity = kOne;
    return {tags::CleanFormValue(line.substr(0, code_end)), std::move(quantity)};
}

QuickEntryLine ReadLine(std::string_view line) {
    for (const char mark : {'\t', ';'}) {
        const auto first = line.find(mark);
        if (first != line.npos) return Parted(line, first, line.rfind(mark) + 1);
    }
    const auto blank = line.rfind(' ');
    if (blank == line.npos) return {std::string(line), std::string(kOne)};
    return Parted(line, blank, blank + 1);
}

}  // namespace

std::vector<QuickEntryLine> ReadQuickEntry(std::string_view text) {
    std::vector<QuickEntryLine> lines;
    for (const std::string_view raw : base::Split(text, '\n')) {
        // Cells at the end of a pasted row may be empty.
        std::string line = tags::CleanFormValue(base::Replaced(raw, "\r", " "));
        while (!line.empty() && (line.back() == '\t' || line.back() == ' ')) line.pop_back();
        if (!line.empty()) lines.push_back(ReadLine(line));
    }
    return lines;
}

}  // namespace zebtell::orders
