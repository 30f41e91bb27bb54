#include "erp/odbc/connection_string.h"

#include <gtest/gtest.h>

#include "erp/database.h"

namespace zebtell::erp {
namespace {

using odbc::ConnectionString;
using odbc::HasLogin;
using odbc::WithLogin;

TEST(ConnectionStringTest, WhoLogsOnIsReadFromIt) {
    const struct {
        const char* path;
        bool has_login;
    } rows[] = {
        {"erp", false},
        {"DSN=erp", false},
        {"DSN=erp;UID=portal;PWD=x", true},
        {"Driver={A driver; UID=x};Server=s", false},
        {"Server=s; uid =portal", true},
        {"Server=s;Trusted_Connection=yes", true},
        {"Server=s;PWD={}};UID=x;};Database=d", false},
        {"Server=s;PWD={open", false},
        {"", false},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(HasLogin(ConnectionString(row.path)), row.has_login) << row.path;
    }
    EXPECT_EQ(ConnectionString(" erp "), "DSN=erp");
}

TEST(ConnectionStringTest, NamesAndPasswordsStayValues) {
    EXPECT_EQ(WithLogin("DSN=erp;", "mari", "a;UID=sa}b"), "DSN=erp;UID={mari};PWD={a;UID=sa}}b}");
    constexpr auto kServer = data::DatabaseType::kSqlServer;
    const DatabaseAddress own = AddressFor(kServer, "DSN=erp", "mari", "x");
    EXPECT_TRUE(own.is_users_own);
    EXPECT_EQ(own.path, "DSN=erp;UID={mari};PWD={x}");
    EXPECT_EQ(AddressFor(kServer, "DSN=erp;UID=p", "mari", "x").path, "DSN=erp;UID=p");
    EXPECT_EQ(AddressFor(data::DatabaseType::kSqlite, "a.db", "mari", "x").path, "a.db");
}

}  // namespace
}  // namespace zebtell::erp
