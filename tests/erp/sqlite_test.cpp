#include <gtest/gtest.h>
#include <sqlite3.h>

#include <random>

#include "base/runtime_error.h"
#include "erp/order_price.h"
#include "erp/sqlite/backend.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

using base::errors::kStatementFailed;
using base::errors::kUnspecified;

constexpr auto kSqlite = data::DatabaseType::kSqlite;

std::string DescriptionOf(const std::function<void()>& work) {
    try {
        work();
    } catch (const base::RuntimeError& error) {
        return error.what();
    }
    return "no error";
}

class SqliteTest : public PortalTest {
  protected:
    void SetUp() override { connection_ = company_->MakeBackend()->Connect(Access::kRead); }
    std::string Value(const std::string& expression, std::vector<base::Value> values = {}) {
        const auto cursor = connection_->Query({"select " + expression, std::move(values)});
        return cursor->Next() ? (cursor->Get(0).IsNull() ? "null" : cursor->Get(0).ToPlainText())
                              : "no row";
    }

    std::unique_ptr<Connection> connection_;
};
INSTANTIATE_TEST_SUITE_P(Databases,
                         SqliteTest,
                         testing::Values(DatabaseKinds().front()),
                         [](const auto& test) { return test.param.name; });

TEST_P(SqliteTest, FunctionsOfTranslatedStatements) {
    const struct {
        const char *expression, *value;
    } rows[] = {
        {"erp_round(1.005, 2)", "1.01"},
        {"erp_round(2.675, 2)", "2.68"},
        {"erp_round(-2.5, 0)", "-3"},
        {"erp_round(0.5, 0)", "1"},
        {"erp_round(0.49999999999999994, 0)", "1"},  // half on 15 digits
        {"erp_round(1234.5, -2)", "1200"},
        {"erp_round(1250, -2)", "1300"},
        {"erp_round(49, -2)", "0"},
        {"erp_round(9.995, 2)", "10"},
        {"erp_round(123456789012.345, 2)", "123456789012.35"},
        {"erp_round(1e300, 2)", "1e+300"},
        {"erp_round(0.000001, 2)", "0"},
        {"erp_round(null, 2)", "null"},
        {"erp_div(7, 2)", "3.5"},
        {"erp_div(1, 0)", "null"},
        {"erp_div(null, 2)", "null"},
        {"erp_like('Kruvi M6', '%kruvi%m6%')", "1"},
        {"erp_like('ÕLI', 'õ_i')", "1"},
        {"erp_like('õli', '_LI')", "1"},
        {"erp_like('õli', '__li')", "0"},
        {"erp_like('100%', '100\\%')", "1"},
        {"erp_like('100x', '100\\%')", "0"},
        {"erp_like('a_b', 'a\\_b')", "1"},
        {"erp_like('axb', 'a\\_b')", "0"},
        {"erp_like('', '%')", "1"},
        {"erp_like('', '_')", "0"},
        {"erp_like('abcabd', '%abd')", "1"},
        {"erp_like('aaab', 'a%a%ab')", "1"},
        {"erp_like('aab', '%aaa%')", "0"},
        {"erp_like('abc', 'ab')", "0"},
        {"erp_like(17, '1%')", "1"},
        {"erp_like(null, '%')", "null"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(Value(row.expression), row.value) << row.expression;
    }
}

// Prices on the page come from the query, prices of the order from the document.
TEST_P(SqliteTest, QueriesAndOrdersRoundPricesAlike) {
    std::mt19937 random(20260315);
    for (int i = 0; i < 2000; ++i) {
        const auto price = base::Currency::FromScaled(random() % 100'000'000);
        const double cut = static_cast<double>(static_cast<int>(random() % 20000) - 10000) / 100;
        EXPECT_EQ(Value("erp_div(erp_round(? * (100 + ?), 0), 100)", {price, cut}),
                  PriceWithCut(price, cut).ToText())
            << price.ToText() << " " << cut;
    }
}

TEST_P(SqliteTest, BoundValuesComeBack) {
    const auto connection = company_->MakeBackend()->Connect(Access::kWrite);
    connection->Begin();
    connection->Execute(
        {"update SDOrder set Amount = ?, WantedDate = ?, Explanation = ?, State = ?"
         " where ID = 11",
         {base::Currency::FromText("922337203.6854"),
          *base::DateTime::FromIso("2026-02-28"),
          "Õ'\"\n;",
          true}});
    const auto row = connection->Query(
        {"select Amount, WantedDate, Explanation, State from SDOrder where ID = 11", {}});
    ASSERT_TRUE(row->Next());
    EXPECT_EQ(row->Get(0), base::Value(base::Currency::FromText("922337203.6854")));
    EXPECT_EQ(row->Get(1), base::Value(*base::DateTime::FromIso("2026-02-28")));
    EXPECT_EQ(row->Get(2), base::Value("Õ'\"\n;"));
    EXPECT_EQ(row->Get(3), base::Value(1));
    EXPECT_FALSE(row->Next());
    connection->Rollback();
}

TEST_P(SqliteTest, ReadingConnectionsCanNotWrite) {
    for (const char* sql : {"delete from GRTax",
                            "create table x (a)",
                            "attach 'x.db' as x",
                            "select 1; delete from GRTax",
                            ""}) {
        EXPECT_EQ(ErrorOf([&] { connection_->Execute({sql, {}}); }), kStatementFailed) << sql;
    }
    EXPECT_EQ(company_->Show("select count(*) from GRTax"), "2;");
}

TEST_P(SqliteTest, LongStatementsEnd) {
    EXPECT_EQ(DescriptionOf([&] {
                  connection_->Execute(
                      {"with recursive n(i) as (select 1 union all select i + 1 "
                       "from n) select count(*) from n",
                       {}});
              }),
              "The statement took too long");
    connection_->Execute({"select count(*) from GRTax", {}});
}

TEST_P(SqliteTest, ABusyDatabaseIsReadAndRefusesToStore) {
    const auto portal = LogOn();
    const auto order = portal->OpenTable("SDOrder")->Open(0);
    const auto row = order->Rows()->AddRow();
    row->SetField("IDGRArticle", 1);
    row->SetField("Quantity", 1);
    const auto other = company_->MakeBackend()->Connect(Access::kWrite);
    other->Begin();
    other->Execute({"update GRTax set Name = 'x'", {}});
    EXPECT_EQ(Text(*portal->Load("GRTax", 1), "Name"), "20 %");
    EXPECT_EQ(DescriptionOf([&] { order->Save(); }), "The database is busy");
    other->Rollback();
    order->Save();
    EXPECT_EQ(company_->Show("select max(Number) from SDOrder"), "504;");
}

TEST(SqliteFileTest, WhatIsNotADatabaseIsNamedWithoutItsPath) {
    const TempFolder folder;
    folder.Write("text.db", std::string(5000, 'x'));
    Databases databases([] { return base::DateTime::Now(); });
    const struct {
        const char *file, *description;
    } rows[] = {{"missing.db", "The company database is not there"},
                {"text.db", "The company database is not a database"},
                {"", "The company database is not there"}};
    for (const auto& row : rows) {
        const std::string path = (folder.path() / row.file).string();
        const auto portal = databases.NewApplication();
        portal->Initialise("ZEBTell", "WEBUser", "WEBGuest", "");
        EXPECT_EQ(DescriptionOf([&] { portal->Logon(kSqlite, path, "mari", "sala"); }),
                  row.description);
        EXPECT_FALSE(databases.IsReachable(kSqlite, path));
    }
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "missing.db"));
    EXPECT_FALSE(databases.IsReachable(data::DatabaseType::kSqlServer, "x"));
}

TEST_P(SqliteTest, AReachableDatabaseSaysSo) {
    EXPECT_TRUE(databases_->IsReachable(company_->type(), company_->path()));
}

}  // namespace
}  // namespace zebtell::erp
