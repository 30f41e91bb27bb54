#include <gtest/gtest.h>

#include <algorithm>

#include "base/text.h"
#include "erp/access.h"
#include "tests/erp/sql_database.h"

namespace zebtell::erp {
namespace {

TEST(AccessTest, RulesFitTheSchema) {
    for (const AccessRule& rule : AccessPolicy()) {
        SCOPED_TRACE(rule.table);
        const TableInfo* table = Database().schema().Find(rule.table);
        ASSERT_TRUE(table);
        EXPECT_EQ(table->name, rule.table);
        EXPECT_EQ(FindAccessRule(rule.table), &rule);
        for (const std::string_view column : rule.hidden_columns) {
            EXPECT_TRUE(table->FindColumn(column)) << column;
        }
        for (const std::string_view column : rule.writable_columns) {
            EXPECT_TRUE(table->FindColumn(column)) << column;
        }
    }
    EXPECT_FALSE(FindAccessRule("sqlite_master"));
}

// Nobody gets to read a table because somebody has added it to the database.
TEST(AccessTest, EveryTableOfTheSchemaHasItsRule) {
    for (const TableInfo& table : Database().schema().tables()) {
        EXPECT_TRUE(FindAccessRule(table.name)) << table.name;
    }
    Schema more({{"Salaries", false, {{"ID", ColumnType::kInteger, ""}}}});
    EXPECT_EQ(ShownOrError([&] {
                  return Translator(more, Dialect::kSqlite)
                      .ListKeys(FirstCustomer(), "Salaries", "", "", {});
              }),
              "no such table");
}

TEST(AccessTest, CustomersWriteOnlyWhatIsTheirs) {
    const struct {
        const char* table;
        const char* column;
        bool writable;
    } rows[] = {
        {"SDOrder", "Explanation", true},
        {"SDOrder", "WantedDate", true},
        {"SDOrder", "IDGRCompany", false},
        {"SDOrder", "State", false},
        {"SDOrder", "Number", false},
        {"SDOrder", "NeedsReview", false},
        {"SDOrderRow", "Quantity", true},
        {"SDOrderRow", "IDSDOrder", false},
        {"SDOrderRow", "Status", false},
        {"SDOrderRow", "DeliveredQuantity", false},
        {"GRCompany", "PriceCut", false},
        {"SYUser", "PasswordHash", false},
        {"GRPriceListRel", "Price", false},
        {"SDInvoice", "PaidAmount", false},
    };
    for (const auto& row : rows) {
        const auto& writable = FindAccessRule(row.table)->writable_columns;
        EXPECT_EQ(std::count(writable.begin(), writable.end(), row.column), row.writable ? 1 : 0)
            << row.table << "." << row.column;
    }
}

TEST(SchemaTest, LinksAndChildren) {
    const Schema& schema = Database().schema();
    EXPECT_EQ(schema.Find("syuser")->FindLink("PARTNER")->links_to, "GRCompany");
    EXPECT_FALSE(schema.Find("SYUser")->FindLink("Name"));
    const struct {
        const char* child;
        const char* parent;
        const char* column;
    } rows[] = {
        {"SDOrderRow", "SDOrder", "IDSDOrder"},
        {"GDTax", "SDInvoice", "IDGDocument"},
        {"GRCompany", "GRCompany", "IDSettlCompany"},
        {"SYUser", "GRCompany", "IDPartner"},
        {"GRArticleCatRel", "GRArticle", "IDGRArticle"},
        {"GRArticle", "SDOrder", nullptr},
    };
    for (const auto& row : rows) {
        const Column* link = schema.ChildLink(*schema.Find(row.child), *schema.Find(row.parent));
        EXPECT_EQ(link ? link->name : "", row.column ? row.column : "") << row.child;
    }
}

// How the database goes about it, steps with ";" between them.
std::string Plan(BoundSql sql) {
    sql.text = "explain query plan " + sql.text;
    std::string plan;
    const std::string rows = Database().Run(sql);
    for (const std::string_view row : base::Split(rows, ';')) {
        plan.append(row.substr(row.rfind('|') + 1)).append(";");
    }
    return plan;
}

TEST(PlanTest, ScopesLeaveTheIndexesToTheConditions) {
    const Translator translator = Database().translator();
    const Reader reader = FirstCustomer();
    const std::vector<std::int64_t> ids = {1, 2};
    const std::vector<std::string> fields = {"GRArticle.GRTax.TaxPercent"};
    const struct {
        const char* label;
        BoundSql sql;
        const char* step;
    } rows[] = {
        {"rows by their keys",
         translator.RowsByID(reader, "GRPriceListRel", ids, fields),
         "SEARCH t1 USING INTEGER PRIMARY KEY"},
        {"links by their keys",
         translator.RowsByID(reader, "GRPriceListRel", ids, fields),
         "SEARCH t3 USING INTEGER PRIMARY KEY"},
        {"rows of a document",
         translator.ListKeys(reader, "SDOrderRow", "IDSDOrder=100", "RowNo", {}),
         "SEARCH t1 USING INDEX SDOrderRow_Order (IDSDOrder=?)"},
        {"own documents",
         translator.ListKeys(reader, "SDOrder", "", "DocDate desc", {}),
         "SEARCH t1 USING COVERING INDEX SDOrder_Company (IDGRCompany=?)"},
        {"lines of a list",
         translator.ListKeys(reader,
                             "GRPriceListRel",
                             "{GRPriceListRel.ID in (select ID from SQPriceList5 where "
                             "IDGRPriceList=20)}",
                             "",
                             {}),
         "SEARCH t1 USING INTEGER PRIMARY KEY"},
        {"prices of some articles",
         translator.Select(
             reader,
             "select s.ID, rc.c from SQPriceList5 s left join (select rel.PriceCut c, "
             "ga.ID as a from GRPriceCatRel rel inner join GRArticle ga on "
             "ga.IDGRArticlePriceCat=rel.IDGRArticlePriceCat) rc on "
             "s.IDGRArticle=rc.a where s.IDGRArticle in (1,2)"),
         "SEARCH t3 USING COVERING INDEX GRArticle_PriceCat (IDGRArticlePriceCat=? AND rowid=?)"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.label);
        const std::string plan = Plan(row.sql);
        EXPECT_NE(plan.find(row.step), std::string::npos) << plan << "\n" << row.sql.text;
        EXPECT_EQ(plan.find("SCAN t"), std::string::npos) << plan;
    }
}

}  // namespace
}  // namespace zebtell::erp
