#include <gtest/gtest.h>

#include <string>

#include "erp/password.h"
#include "tests/demo/demo_fixture.h"

namespace zebtell::demo {
namespace {

class CompanyTest : public DemoCompanyTest {};

TEST_F(CompanyTest, BarcodesHaveRightCheckDigits) {
    const auto codes = sql().Rows("select Barcode from GRArticle where Barcode is not null");
    ASSERT_GT(codes.size(), 2500U);
    for (const Sql::Row& row : codes) {
        const std::string& code = row[0];
        ASSERT_EQ(code.size(), 13U) << code;
        int sum = 0;
        for (std::size_t i = 0; i < 13; ++i) {
            sum += (code[i] - '0') * (i % 2 == 0 ? 1 : 3);
        }
        ASSERT_EQ(sum % 10, 0) << code;
    }
    EXPECT_EQ(sql().Number("select count(*) - count(distinct Barcode) from GRArticle "
                           "where Barcode is not null"),
              0);
}

struct Count {
    const char* what;
    const char* sql;
    std::int64_t expected;
};

TEST_F(CompanyTest, HasWhatItShouldHave) {
    const Count counts[] = {
        {"articles and the transport", "select count(*) from GRArticle", 3001},
        {"categories in use", "select count(distinct IDGRArticleCat) from GRArticleCatRel", 30},
        {"units", "select count(distinct Unit) from GRArticle", 5},
        {"default lists", "select count(*) from GRPriceList where IsDefault", 1},
        {"lists from another list",
         "select count(*) from GRPriceList where IDSrcPriceList is not null",
         1},
        {"names used twice", "select count(*) - count(distinct Name) from GRArticle", 0},
        {"texts longer than their columns",
         "select count(*) from GRArticle where length(Name) > 150 or length(Code) > 40",
         0},
        {"countries", "select count(distinct Country) from GRCompany", 3},
        {"companies", "select count(*) from GRCompany", 40},
        {"companies that may not order",
         "select count(*) from GRCompany where not OrdersAllowed",
         3},
        {"customers without any list",
         "select count(*) from GRCompany c left join GRCompany s on s.ID = c.IDSettlCompany where "
         "c.IDGRPriceList is null and s.IDGRPriceList is null",
         1},
        {"customers with the list of who pays",
         "select count(*) from GRCompany c join GRCompany s on s.ID = c.IDSettlCompany where "
         "c.IDGRPriceList is null and s.IDGRPriceList is not null",
         2},
        {"users", "select count(*) from SYUser", 45},
        {"users of other companies' people",
         "select count(*) from SYUser u join GRCompContPerson p on p.ID = u.IDGRCompContPerson "
         "where p.IDGRCompany <> u.IDPartner",
         0},
    };
    for (const Count& count : counts) {
        EXPECT_EQ(sql().Number(count.sql), count.expected) << count.what;
    }
}

TEST_F(CompanyTest, HasNamesThatPagesMustEscape) {
    for (const char* part : {"'", "&", "<", "\"", "×", "ā", "õ", "ü"}) {
        const std::string quoted = part[0] == '\'' ? "''''" : "'" + std::string(part) + "'";
        EXPECT_GE(sql().Number("select count(*) from GRArticle where instr(Name, " + quoted + ")"),
                  1)
            << part;
    }
    EXPECT_EQ(sql().Text("select Name from GRArticle where Code = 'POL-M4-010'"),
              "Kuuskantpolt M4×10 DIN 933 8.8 Zn");
}

struct User {
    const char* name;
    const char* password;
    const char* expected;  // guest, disabled, whether the company may order, its list
};

TEST_F(CompanyTest, LetsTheKnownUsersLogOn) {
    const User users[] = {
        {"mari", "mari-demo", "0|0|1|1"},
        {"janis", "janis-demo", "0|0|1|2"},
        {"blokk", "blokk-demo", "0|0|0|1"},
        {"WebGuest", "", "1|0|1|1"},
        {"endine", "endine-demo", "0|1|1|1"},
        {"klient14", "klient-demo", "0|0|1|3"},
    };
    for (const User& user : users) {
        const auto rows = sql().Rows(
            std::string("select PasswordHash, Guest || '|' || Disabled || '|' || OrdersAllowed || "
                        "'|' || IDGRPriceList from SYUser join GRCompany on GRCompany.ID = "
                        "IDPartner where SYUser.Name = '") +
            user.name + "'");
        ASSERT_EQ(rows.size(), 1U) << user.name;
        EXPECT_TRUE(erp::IsPassword(user.password, rows[0][0])) << user.name;
        EXPECT_FALSE(erp::IsPassword("another", rows[0][0])) << user.name;
        EXPECT_EQ(rows[0][1], user.expected) << user.name;
    }
    EXPECT_EQ(sql().Number("select count(*) from GRCompContPerson p join SYUser u on "
                           "u.IDGRCompContPerson = p.ID where u.Name = 'mari' and "
                           "p.Name like 'Mari %'"),
              1);
}

}  // namespace
}  // namespace zebtell::demo
