#include "orders/quick_entry.h"

#include <gtest/gtest.h>

namespace zebtell::orders {
namespace {

TEST(QuickEntry, LinesAsPeopleAndSpreadsheetsWriteThem) {
    struct Case {
        const char* label;
        const char* text;
        const char* lines;
    };
    const Case cases[] = {
        {"pasted cells", "A-1\t2\r\nB 2\t1,5\r\n", "[A-1|2][B 2|1,5]"},
        {"a name between them", "A-1\tKruvi M6\t10", "[A-1|10]"},
        {"empty cells at the end, empty lines", "A-1\t2\t\t\n\n\t\n \r\nB-2\t3", "[A-1|2][B-2|3]"},
        {"semicolons", "A-1; 2\nB-2;Mutter;4", "[A-1|2][B-2|4]"},
        {"blanks, also in the code", "A-1   2\n  B 2  3 ", "[A-1|2][B 2|3]"},
        {"scanned", "4740000000011\n4740000000028\n", "[4740000000011|1][4740000000028|1]"},
        {"no-break spaces",
         "A-1\xC2\xA0"
         "2",
         "[A-1|2]"},
        {"a quantity without a code", "\t5", "[|5]"},
        {"nothing", "", ""},
    };
    for (const Case& c : cases) {
        std::string lines;
        for (const QuickEntryLine& line : ReadQuickEntry(c.text)) {
            lines += "[" + line.code + "|" + line.quantity + "]";
        }
        EXPECT_EQ(lines, c.lines) << c.label;
    }
}

}  // namespace
}  // namespace zebtell::orders
