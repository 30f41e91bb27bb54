#include <gmock/gmock.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <fstream>
#include <functional>

#include "base/runtime_error.h"
#include "demo/sql_files.h"
#include "tests/demo/demo_fixture.h"
#include "tests/demo/digest.h"

namespace zebtell::demo {
namespace {

namespace fs = std::filesystem;

// What making the company failed with, "" when it did not.
std::string FailureOf(const fs::path& file, const DemoOptions& options) {
    try {
        MakeDemoCompany(file, options);
        return "";
    } catch (const base::RuntimeError& error) {
        return error.description();
    }
}

bool IsEmpty(const TempFolder& folder) {
    return fs::is_empty(folder.path());
}

TEST(MakingTest, GivesTheSameDataOnEveryMachine) {
    const TempFolder folder;
    MakeDemoCompany(folder.path() / "a.db", SmallCompany());
    MakeDemoCompany(folder.path() / "b.db", SmallCompany());
    EXPECT_EQ(DigestOf(folder.path() / "a.db"), DigestOf(folder.path() / "b.db"));
    EXPECT_EQ(DigestOf(folder.path() / "a.db"), 7259847541838216593U)
        << "the data has changed, or depends on "
           "the compiler or the machine";
}

TEST(MakingTest, IsAsLargeAsAskedFor) {
    const TempFolder folder;
    DemoOptions options = SmallCompany();
    options.articles = 12'000;  // more than the combinations of most kinds
    options.companies = 90;     // more than there are names
    options.order_rows = 2500;
    MakeDemoCompany(folder.path() / "demo.db", options);
    const Sql sql(folder.path() / "demo.db");
    EXPECT_EQ(sql.Number("select count(*) - 1 from GRArticle"), 12'000);
    EXPECT_EQ(sql.Number("select count(distinct Name) from GRArticle"), 12'001);
    EXPECT_EQ(sql.Number("select count(distinct Name) from GRCompany"), 90);
    EXPECT_EQ(sql.Number("select count(*) from SDOrderRow where Status = 0"), 2500);
    EXPECT_GE(sql.Text("select min(DocDate) from SDOrder"), "2025-11-20");
    EXPECT_EQ(sql.Rows("pragma foreign_key_check").size(), 0U);
}

TEST(MakingTest, HasTheIndexesOfTheSchemaAndIsInWalMode) {
    const TempFolder folder;
    MakeDemoCompany(folder.path() / "demo.db", SmallCompany());
    std::ofstream(folder.path() / "plain.db");
    const Sql plain(folder.path() / "plain.db");
    plain.Rows(std::string(kSchemaSql) + std::string(kViewsSql));
    const Sql made(folder.path() / "demo.db");
    const char* const kObjects =
        "select type, name, sql from sqlite_master where name not like 'sqlite%' order by 1, 2";
    EXPECT_EQ(made.Rows(kObjects), plain.Rows(kObjects));
    EXPECT_EQ(made.Text("pragma journal_mode"), "wal");
}

TEST(MakingTest, RefusesSizesOutOfRange) {
    const TempFolder folder;
    const std::function<void(DemoOptions&)> changes[] = {
        [](DemoOptions& options) { options.articles = 99; },
        [](DemoOptions& options) { options.companies = -1; },
        [](DemoOptions& options) { options.years = 0; },
        [](DemoOptions& options) { options.order_rows = 10'000'001; },
    };
    for (const auto& change : changes) {
        DemoOptions options = SmallCompany();
        change(options);
        EXPECT_THAT(FailureOf(folder.path() / "demo.db", options),
                    testing::StartsWith("The number of "));
        EXPECT_TRUE(IsEmpty(folder));
    }
}

TEST(MakingTest, NeverOverwritesAFile) {
    const TempFolder folder;
    const fs::path file = folder.path() / "demo.db";
    folder.Write("demo.db", "orders of years");
    EXPECT_EQ(FailureOf(file, SmallCompany()), "The file " + file.string() + " exists already");
    EXPECT_EQ(folder.Read("demo.db"), "orders of years");

    fs::rename(file, folder.path() / "demo.db.new");
    EXPECT_EQ(FailureOf(file, SmallCompany()), "The file " + file.string() + ".new exists already");
    EXPECT_EQ(folder.Read("demo.db.new"), "orders of years");
    EXPECT_FALSE(fs::exists(file));
}

TEST(MakingTest, LeavesNothingWhenTheDiskIsFull) {
    const TempFolder folder;
    struct rlimit before = {};
    ASSERT_EQ(getrlimit(RLIMIT_FSIZE, &before), 0);
    auto* const handler = std::signal(SIGXFSZ, SIG_IGN);
    for (const rlim_t bytes : {4096U, 65536U, 300'000U}) {
        struct rlimit limit = before;
        limit.rlim_cur = bytes;
        ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &limit), 0);
        const std::string failure = FailureOf(folder.path() / "demo.db", SmallCompany());
        ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &before), 0);
        EXPECT_NE(failure, "") << bytes;
        EXPECT_TRUE(IsEmpty(folder)) << bytes;
    }
    std::signal(SIGXFSZ, handler);
}

TEST(MakingTest, LeavesNoHalfDatabaseWhenKilled) {
    const TempFolder folder;
    const fs::path file = folder.path() / "demo.db";
    DemoOptions large = OnAFriday();
    large.order_rows = 2'000'000;
    const pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
        MakeDemoCompany(file, large);
        _exit(0);
    }
    while (!fs::exists(folder.path() / "demo.db.new")) {
        usleep(1000);
    }
    usleep(100'000);
    kill(child, SIGKILL);
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFSIGNALED(status)) << "it ended before it was killed";
    EXPECT_FALSE(fs::exists(file));
}

TEST(MakingTest, FailsWhereItMayNotWrite) {
    const TempFolder folder;
    EXPECT_EQ(FailureOf(folder.path() / "no such folder" / "demo.db", SmallCompany()),
              "unable to open database file");
}

}  // namespace
}  // namespace zebtell::demo
