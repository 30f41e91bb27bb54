#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "erp/user_admin.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

using base::errors::kLogonFailed;

class LogonTest : public PortalTest {};
INSTANTIATE_TEST_SUITE_P(Databases,
                         LogonTest,
                         testing::ValuesIn(DatabaseKinds()),
                         [](const auto& test) { return test.param.name; });

TEST_P(LogonTest, NameInAnyCaseAndExactPassword) {
    const struct {
        const char *user, *password;
        int error;
    } rows[] = {{"mari", "sala", 0},
                {"MARI", "sala", 0},
                {"õIE", "sala", 0},
                {"WebGuest", "sala", 0},
                {"mari", "SALA", kLogonFailed},
                {"mari", "", kLogonFailed},
                {"nobody", "sala", kLogonFailed},
                {"mar%", "sala", kLogonFailed},
                {"' or 1=1 --", "sala", kLogonFailed},
                {"", "", kLogonFailed},
                {"endine", "sala", kLogonFailed}};
    for (const auto& row : rows) {
        EXPECT_EQ(ErrorOf([&] { LogOn(row.user, row.password); }), row.error) << row.user;
    }
}

TEST_P(LogonTest, NothingIsReadBeforeTheLogOn) {
    const auto portal = databases_->NewApplication();
    EXPECT_EQ(ErrorOf([&] { portal->OpenList("GRArticle", "", ""); }), base::errors::kObjectNotSet);
    EXPECT_EQ(ErrorOf([&] { portal->Load("GRArticle", 1); }), base::errors::kObjectNotSet);
}

TEST_P(LogonTest, OrdersUseTheDefaultPriceList) {
    const auto portal = LogOn("Õie");
    EXPECT_EQ(portal->DefaultLink("SDOrder", "GRPriceList"), 1);
    EXPECT_EQ(portal->DefaultLink("SDOrder", "GRCompany"), 0);
    EXPECT_EQ(ErrorOf([&] { portal->DefaultLink("SDOrder", "GRTax"); }),
              base::errors::kStatementFailed);
}

TEST_P(LogonTest, AdministratorsAddAndChangeUsers) {
    UserAdmin users(company_->type(), company_->path());
    users.Add({.name = "Ülo", .password = "uus", .display_name = "Ülo", .partner_code = "k1"});
    LogOn("ÜLO", "uus");
    EXPECT_EQ(Text(*user_, "Partner.Name"), "Puit OÜ");
    users.SetPassword("ülo", "veel uuem");
    EXPECT_EQ(ErrorOf([&] { LogOn("Ülo", "uus"); }), kLogonFailed);
    LogOn("Ülo", "veel uuem");
    users.SetDisabled("Ülo", true);
    EXPECT_EQ(ErrorOf([&] { LogOn("Ülo", "veel uuem"); }), kLogonFailed);

    const auto list = users.List();
    ASSERT_EQ(list.size(), 5U);
    const auto ulo =
        std::find_if(list.begin(), list.end(), [](const auto& user) { return user.name == "Ülo"; });
    ASSERT_NE(ulo, list.end());
    EXPECT_TRUE(ulo->disabled && !ulo->guest);
    EXPECT_EQ(ulo->partner_code + " " + ulo->partner_name, "K1 Puit OÜ");

    constexpr int kRefused = base::errors::kInvalidCall;
    EXPECT_EQ(ErrorOf([&] { users.Add({.name = "MARI", .password = "x"}); }), kRefused);
    EXPECT_EQ(ErrorOf([&] { users.Add({.name = " ", .password = "x"}); }), kRefused);
    EXPECT_EQ(ErrorOf([&] { users.Add({.name = "uus", .password = "x", .partner_code = "K99"}); }),
              kRefused);
    EXPECT_EQ(ErrorOf([&] { users.SetPassword("nobody", "x"); }), kRefused);
}

}  // namespace
}  // namespace zebtell::erp
