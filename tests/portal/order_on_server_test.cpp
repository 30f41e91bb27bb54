#include <gmock/gmock.h>

#include <cstdlib>

#include "erp/database.h"
#include "tests/portal/portal_fixture.h"
#include "tests/support/server_company.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;

// The order flow on the SQL Server database that ZEBTELL_TEST_ODBC names, which holds nothing else.
class OrderOnServer : public PortalTest {
  protected:
    void SetUp() override {
        path_ = std::getenv("ZEBTELL_TEST_ODBC");
        if (!path_) {
            GTEST_SKIP() << "ZEBTELL_TEST_ODBC names no database";
        }
        PortalTest::SetUp();
        portal.reset();
        server_ = erp::MakeBackend(data::DatabaseType::kSqlServer, path_);
        erp::DropCompany(*server_);
        erp::CopyCompany(folder.path() / "company.db", *server_);
        StartOn("Type=MSSQL\r\nPath=" + std::string(path_), kUsualSettings);
    }
    void TearDown() override {
        portal.reset();
        if (server_) {
            erp::DropCompany(*server_);
        }
    }

    const char* path_ = nullptr;
    std::unique_ptr<erp::Backend> server_;
};

TEST_F(OrderOnServer, NamedUserFromLogonToOrder) {
    Browser mari = MariLoggedOn();
    EXPECT_THAT(mari.Get("Kaubainfo"), HasSubstr("{KR-1|Kruvi M6 pikk|10,00|8,50|10,03|ID_1101|"));
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "4"}, {"ID_1103", "2,5"}});
    EXPECT_THAT(mari.page(), HasSubstr("total=36,52]"));
    mari.Post("Kaubainfo&event=Tellimus", {{"Vormista", "1"}});
    mari.Post("Kinnitus&event=LisaTellimus",
              {{"ZEB_But_Vormista", "1"},
               {"ZEB_Komment", "tooge õue 🔩"},
               {"SDOrder.WantedDate", "2026-12-01"}});
    EXPECT_THAT(mari.page(), HasSubstr("[tellimus  just saved number=7004 "));
    EXPECT_THAT(mari.page(),
                HasSubstr("comment=tooge õue 🔩 sum=36,52 tax=8,39 all=44,91]\n"
                          "(KR-1|4,00|34,00|)\n(OR-1|2,50|2,52|)\n"
                          "tax(9|2,52|0,23)\ntax(24|34,00|8,16)\n"));
    EXPECT_EQ(mari.Ask("/healthz", "GET", "").status, 200);
}

}  // namespace
}  // namespace zebtell
