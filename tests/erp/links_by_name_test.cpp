#include "erp/links_by_name.h"

#include <gtest/gtest.h>

#include "tests/erp/sql_database.h"

namespace zebtell::erp {
namespace {

std::string LinksOf(const std::vector<TableInfo>& tables) {
    std::string links;
    for (const TableInfo& table : tables) {
        for (const Column& column : table.columns) {
            if (!column.links_to.empty()) {
                links += table.name + "." + column.name + " > " + column.links_to + "\n";
            }
        }
    }
    return links;
}

TEST(LinksByNameTest, ADatabaseWithoutForeignKeysHasTheSameLinks) {
    const std::vector<TableInfo>& tables = Database().schema().tables();
    std::vector<TableInfo> stripped = tables;
    for (TableInfo& table : stripped) {
        for (Column& column : table.columns) {
            column.links_to.clear();
        }
    }
    AddLinksByName(stripped);
    EXPECT_EQ(LinksOf(stripped), LinksOf(tables));
    EXPECT_NE(LinksOf(tables).find("SDOrder.ID > GDocument"), std::string::npos);
}

TEST(LinksByNameTest, AForeignKeyGoesBeforeTheName) {
    const auto column = [](const char* name) { return Column{name, ColumnType::kInteger, ""}; };
    std::vector<TableInfo> tables = {
        {"grcompany", false, {column("ID"), {"idparent", ColumnType::kInteger, "Group"}}},
        {"Group", false, {column("ID")}},
        {"EREmployee", true, {column("IDGroup"), column("IDGRCOMPANY"), column("IDNobody")}}};
    AddLinksByName(tables);
    EXPECT_EQ(LinksOf(tables),
              "grcompany.idparent > Group\n"
              "EREmployee.IDGroup > Group\n"
              "EREmployee.IDGRCOMPANY > grcompany\n");
}

}  // namespace
}  // namespace zebtell::erp
