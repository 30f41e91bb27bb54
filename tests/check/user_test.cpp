#include <gmock/gmock.h>

#include <cstdio>
#include <iostream>

#include "app/commands.h"
#include "base/runtime_error.h"
#include "erp/password.h"
#include "tests/check/check_fixture.h"
#include "tests/demo/sql.h"

namespace zebtell::app {
namespace {

class UserTest : public check::CheckTest {
  protected:
    void SetUp() override {
        CheckTest::SetUp();
        Change("INSERT INTO GRCompany (ID, Code, Name) VALUES (7, 'OMA', 'Oma Äri OÜ')");
    }

    // Standard input is this text, so that the password comes from there also at a terminal.
    void Type(std::string_view text) const {
        folder.Write("input", text);
        ASSERT_NE(std::freopen((folder.path() / "input").c_str(), "r", stdin), nullptr);
        std::cin.clear();
    }

    // What the command prints, or its error.
    template <class Command>
    std::string Output(Command&& command) const {
        testing::internal::CaptureStdout();
        std::string error;
        try {
            EXPECT_EQ(command(), 0);
        } catch (const base::RuntimeError& thrown) {
            error = thrown.description();
        }
        const std::string printed = testing::internal::GetCapturedStdout();
        return error.empty() ? printed : error;
    }

    std::string Add(const erp::UserAdmin::NewUser& user) const {
        return Output([&] { return AddUser(folder.path(), user); });
    }
    std::string List() const {
        return Output([&] { return ListUsers(folder.path()); });
    }
    std::string HashOf(const std::string& name) const {
        const demo::Sql sql(folder.path() / "company.db");
        return sql.Text("SELECT PasswordHash FROM SYUser WHERE Name = '" + name + "'");
    }
};

TEST_F(UserTest, UsersAreAddedChangedAndDisabled) {
    Type("saladus-1\n");
    EXPECT_EQ(
        Add({.name = "mari", .password = {}, .display_name = "Mari M", .partner_code = "OMA"}),
        "Added mari\n");
    Type("\n");
    EXPECT_EQ(Add({.name = "WebGuest", .password = {}, .guest = true}), "Added WebGuest\n");
    EXPECT_EQ(List(), "mari\tuser\tMari M\tOMA\tOma Äri OÜ\nWebGuest\tguest\t\t\t\n");
    EXPECT_TRUE(erp::IsPassword("saladus-1", HashOf("mari")));
    EXPECT_TRUE(erp::IsPassword("", HashOf("WebGuest")));

    Type("saladus-2");
    EXPECT_EQ(Output([&] { return SetUserPassword(folder.path(), "MARI"); }),
              "Changed the password of MARI\n");
    EXPECT_TRUE(erp::IsPassword("saladus-2", HashOf("mari")));
    EXPECT_EQ(Output([&] { return SetUserDisabled(folder.path(), "mari", true); }),
              "Disabled mari\n");
    EXPECT_THAT(List(), testing::HasSubstr("mari\tuser, disabled\t"));
    EXPECT_EQ(Output([&] { return SetUserDisabled(folder.path(), "mari", false); }),
              "Enabled mari\n");
    EXPECT_THAT(List(), testing::HasSubstr("mari\tuser\t"));
}

TEST_F(UserTest, WhatIsNotPossibleChangesNothing) {
    struct Case {
        const char* typed;
        erp::UserAdmin::NewUser user;
        const char* error;
    };
    const Case kCases[] = {
        {"seitse7\n", {.name = "a", .password = {}}, "A password needs at least 8 characters"},
        {"õõõõõõõ\n", {.name = "a", .password = {}}, "A password needs at least 8 characters"},
        {"\n", {.name = "a", .password = {}}, "A password needs at least 8 characters"},
        {"short\n",
         {.name = "a", .password = {}, .guest = true},
         "A password needs at least 8 characters"},
        {"", {.name = "a", .password = {}}, "No password was given"},
        {"\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\n",
         {.name = "a", .password = {}},
         "The password is not UTF-8 text"},
        {"saladus-1\n",
         {.name = "a", .password = {}, .partner_code = "X"},
         "There is no company of that code"},
        {"saladus-1\n",
         {.name = " a", .password = {}},
         "A user's name is not empty and has no blanks around it"},
    };
    for (const Case& each : kCases) {
        Type(each.typed);
        EXPECT_EQ(Add(each.user), each.error);
    }
    EXPECT_EQ(List(), "");
    EXPECT_EQ(Output([&] { return SetUserDisabled(folder.path(), "a", true); }),
              "There is no such user");
    folder.Write("ZEBTell.ini", "");
    EXPECT_EQ(List(), "ZEBTell.ini names no database ([DataBase] Path)");
}

}  // namespace
}  // namespace zebtell::app
