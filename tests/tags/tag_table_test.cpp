#include "tags/tag_table.h"

#include <gtest/gtest.h>

#include <sstream>
#include <stdexcept>

#include "tags/reference.h"

namespace zebtell::tags {
namespace {

bool Ignore(TagCall&) {
    return true;
}

TEST(TagTable, Find) {
    const TagTable table = {
        {"ZEB:Mode.*", Ignore, "modes"},
        {"ZEB:Mode.Print", Ignore, "printed"},
        {"ZEB:Mode.Pr*", Ignore, "never reached"},
        {"*.Row", Ignore, "rows"},
        {"ZEB:Name", Ignore, "name"},
    };
    const struct {
        const char* name;
        const char* expected;
    } rows[] = {
        {"zeb:name", "name"},
        {"zeb:mode.print", "printed"},
        {"zeb:mode.print.row", "modes"},
        {"zeb:mode.", "modes"},
        {"zeb:mode", ""},
        {"zeb:list.row", "rows"},
        {".row", "rows"},
        {"row", ""},
        {"zeb:name.x", ""},
        {"", ""},
    };
    for (const auto& row : rows) {
        const TagRow* found = table.Find(row.name);
        EXPECT_EQ(found == nullptr ? "" : found->help, row.expected) << row.name;
    }
}

TEST(TagTable, DuplicatesAreRefused) {
    EXPECT_THROW((TagTable{{"ZEB:A", Ignore, ""}, {"zeb:a", Ignore, ""}}), std::logic_error);
    EXPECT_THROW((TagTable{{"ZEB:A*", Ignore, ""}, {"ZEB:A*", Ignore, ""}}), std::logic_error);
}

TEST(TagTable, Reference) {
    std::ostringstream out;
    PrintReference(out, "Some", {{"ZEB:A", Ignore, "first"}, {"ZEB:Long", Ignore, "second"}});
    EXPECT_EQ(out.str(), "Some\n  ZEB:A     first\n  ZEB:Long  second\n");
}

}  // namespace
}  // namespace zebtell::tags
