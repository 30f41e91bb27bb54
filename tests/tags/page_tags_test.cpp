#include "tags/page_tags.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <sstream>

#include "base/runtime_error.h"
#include "tags/form_values.h"
#include "tests/tags/session.h"

namespace zebtell::tags {
namespace {

TEST(Page, RowsOfAQuery) {
    const char* text =
        "<ZEB:Query>SQStock;IDGRCompany;;;Code</ZEB:Query>"
        "<ul><ZEB:SQStock.Row><li><ZEB:SQStock>Code</ZEB:SQStock>: "
        "<ZEB:SQStock>Stock;0.0</ZEB:SQStock>"
        "<ZEB:Query.Advance>SQStock</ZEB:Query.Advance></ZEB:SQStock.Row></ul>"
        "<ZEB:SQStock>Code</ZEB:SQStock>";
    const struct {
        std::shared_ptr<fake::List> list;
        const char* expected;
    } rows[] = {
        {fake::MakeList({}), "<ul></ul>"},
        {fake::MakeList({{{"Code", "A"}, {"Stock", 1}}}), "<ul><li>A: 1,0\r\n</ul>"},
        {fake::MakeList({{{"Code", "A"}, {"Stock", 1}},
                         {{"Code", "<ZEB:WEBUser>"}, {"Stock", 2.25}},
                         {{"Code", "C"}, {"Stock", 3}}}),
         "<ul><li>A: 1,0\r\n<li>&lt;ZEB:WEBUser&gt;: 2,3\r\n<li>C: 3,0\r\n</ul>"},
    };
    for (const auto& row : rows) {
        Session session;
        session.application->any_query = row.list;
        EXPECT_EQ(session.Page(text), row.expected);
        EXPECT_THAT(session.application->asked,
                    testing::ElementsAre(
                        "OpenQuery SELECT * FROM SQStock WHERE IDGRCompany=42 ORDER BY Code"));
    }
}

bool Own(TagCall& call) {
    call.tag.Write("own " + std::string(call.NameFrom(4)));
    return true;
}

bool Failing(TagCall& call) {
    call.tag.Write("so far");
    throw base::RuntimeError(base::errors::kTypeMismatch);
}

TEST(Page, OrderOfTheHandlers) {
    Session session;
    session.application->any_query = fake::MakeList({{{"Name", "queried"}}});
    for (const char* name : {"Own", "WEBUser", "Query", "Contact"}) {
        GetQuery(session.state, name, "Kaubainfo");
    }
    GetQuery(session.state, "Elsewhere", "KInfo");
    const TagTable own = {{"ZEB:WEBUser", Own, ""},
                          {"ZEB:Tellimus.Exists", Own, ""},
                          {"ZEB:MuudaKogus", Own, ""},
                          {"ZEB:Own", Own, ""},
                          {"ZEB:List", Own, ""},
                          {"ZEB:Bad", Failing, ""}};
    const struct {
        const char* label;
        const char* text;
        const char* expected;
    } rows[] = {
        {"common first", "<ZEB:WEBUser>Name</ZEB:WEBUser>", "Name"},
        {"then the summary", "<ZEB:Tellimus.Exists>x</ZEB:Tellimus.Exists>", ""},
        {"passed on by the summary", "<ZEB:MuudaKogus/>", "own MuudaKogus"},
        {"own before queries", "<ZEB:Own>Name</ZEB:Own>", "own Own"},
        {"shortened name", "<ZEB:List.Row>x</ZEB:List.Row>", "own List"},
        {"query", "<ZEB:Contact>Name</ZEB:Contact>", "queried"},
        {"query of another page", "<ZEB:Elsewhere>Name</ZEB:Elsewhere>", "Name"},
        {"unknown", "<ZEB:Other>a<ZEB:WEBUser>b</ZEB:WEBUser></ZEB:Other>", "ab"},
        {"error", "a<ZEB:Bad>x</ZEB:Bad>b", "aso farb"},
    };
    for (const auto& row : rows) EXPECT_EQ(session.Page(row.text, &own), row.expected) << row.label;
}

TEST(Page, ErrorsAreLoggedUnderTheHandlersName) {
    const auto folder = std::filesystem::path(testing::TempDir()) / "zebtell_page_tags";
    std::filesystem::remove_all(folder);
    std::filesystem::create_directories(folder);
    std::ofstream(folder / "ZEBTell.ini") << "[WEBLog]\r\nLevel=Detail\r\n";
    Session session;
    host::SettingsStore settings(folder);
    settings.Load();
    host::Services services{settings, {}, [] { return base::DateTime(); }};
    host::SessionState state(services);
    markup::TagForTest tag("ZEB:CreateCombo", "T;a;b;c");
    ProcessPageTag(state, session.call, tag.tag(), "KInfo_ProcessTag", "KInfo", nullptr);
    EXPECT_EQ(tag.TagContents(), "");
    std::stringstream log;
    log << std::ifstream(folder / "ZEBTell.log").rdbuf();
    EXPECT_THAT(log.str(), testing::HasSubstr("KInfo_ProcessTag error:"));
    std::filesystem::remove_all(folder);
}

}  // namespace
}  // namespace zebtell::tags
