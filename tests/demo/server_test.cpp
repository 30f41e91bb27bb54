#include <gtest/gtest.h>

#include <fstream>

#include "base/runtime_error.h"
#include "demo/connection_store.h"
#include "demo/sql_files.h"
#include "erp/sqlite/backend.h"
#include "tests/demo/demo_fixture.h"
#include "tests/demo/digest.h"

namespace zebtell::demo {
namespace {

// A server whose part an SQLite file plays. Links are looked at when all is there, as on a server
// they are made last.
class StandIn : public erp::sqlite::SqliteBackend {
  public:
    using SqliteBackend::SqliteBackend;

    std::unique_ptr<erp::Connection> Connect(erp::Access access) override {
        return std::make_unique<LateLinks>(SqliteBackend::Connect(access), *this);
    }

    int statements = 0;
    int fails_at = 0;  // 0: never

  private:
    class LateLinks : public erp::Connection {
      public:
        LateLinks(std::unique_ptr<Connection> inner, StandIn& server)
            : inner_(std::move(inner)), server_(server) {}
        std::unique_ptr<erp::Cursor> Query(const erp::BoundSql& sql) override {
            return inner_->Query(sql);
        }
        void Execute(const erp::BoundSql& sql) override {
            EXPECT_LE(sql.values.size(), 2100U);
            if (++server_.statements == server_.fails_at) {
                throw base::RuntimeError(base::errors::kUnspecified, "The connection was lost");
            }
            inner_->Execute(sql);
        }
        std::int64_t Insert(const erp::BoundSql& sql) override { return inner_->Insert(sql); }
        void Begin() override {
            inner_->Begin();
            inner_->Execute({"PRAGMA defer_foreign_keys = ON", {}});
        }
        void Commit() override { inner_->Commit(); }
        void Rollback() noexcept override { inner_->Rollback(); }
        erp::DatabaseDescription Describe() override { return inner_->Describe(); }

      private:
        std::unique_ptr<Connection> inner_;
        StandIn& server_;
    };
};

class ServerTest : public testing::Test {
  protected:
    ServerTest() { std::ofstream file(path()); }
    std::filesystem::path path() const { return folder_.path() / "server.db"; }

    TempFolder folder_;
    StandIn server_{path().string()};
};

TEST_F(ServerTest, GetsTheCompanyThatAFileGets) {
    MakeDemoCompany(server_, SmallCompany());
    MakeDemoCompany(folder_.path() / "file.db", SmallCompany());
    EXPECT_EQ(DigestOf(path()), DigestOf(folder_.path() / "file.db"));
    EXPECT_LT(server_.statements, 150);
}

TEST_F(ServerTest, RefusesADatabaseThatHoldsSomething) {
    Sql(path()).Rows("create table Orders (ID integer primary key)");
    EXPECT_THROW(MakeDemoCompany(server_, SmallCompany()), base::RuntimeError);
    EXPECT_EQ(Sql(path()).Text("select group_concat(name) from sqlite_master"), "Orders");
}

TEST_F(ServerTest, LeavesNothingWhenItFails) {
    for (const int statement : {5, 30, 70}) {
        server_.statements = 0;
        server_.fails_at = statement;
        EXPECT_THROW(MakeDemoCompany(server_, SmallCompany()), base::RuntimeError) << statement;
        EXPECT_EQ(Sql(path()).Number("select count(*) from sqlite_master"), 0) << statement;
    }
}

}  // namespace
}  // namespace zebtell::demo
