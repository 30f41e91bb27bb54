#include "tests/support/server_sql_recorder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <mutex>
#include <set>
#include <string>

#include "erp/made_for.h"

namespace zebtell::erp {
namespace {

class Recorder : public testing::Environment {
  public:
    static Recorder& Instance() {
        // gtest deletes it.
        static auto* const recorder = dynamic_cast<Recorder*>(
            testing::AddGlobalTestEnvironment(std::make_unique<Recorder>().release()));
        return *recorder;
    }

    void SetUp() override {
        if (Folder() != nullptr) {
            WatchServerSql([this](const BoundSql& made, const BoundSql& for_server) {
                const std::lock_guard lock(mutex_);
                made_.insert(made.text);
                asked_.insert(for_server.text);
            });
        }
    }

    void TearDown() override {
        if (Folder() == nullptr) return;
        WatchServerSql({});
        std::set_difference(ran_.begin(),
                            ran_.end(),
                            made_.begin(),
                            made_.end(),
                            std::inserter(asked_, asked_.end()));
        std::ofstream out(std::filesystem::path(Folder()) / program_invocation_short_name);
        for (const std::string& statement : asked_) out << statement << "\n";
        EXPECT_TRUE(out.flush());
    }

    void TakeRun(const std::string& statement) {
        const bool is_catalogue = statement.find("sqlite_master") != std::string::npos ||
                                  statement.find("pragma_") != std::string::npos;
        const std::lock_guard lock(mutex_);
        if (!is_catalogue) ran_.insert(statement);
    }

  private:
    static const char* Folder() { return std::getenv("ZEBTELL_TSQL"); }

    std::mutex mutex_;
    std::set<std::string> made_;   // for other databases
    std::set<std::string> ran_;    // by connections
    std::set<std::string> asked_;  // of SQL Server
};

// Before the tests run.
[[maybe_unused]] const Recorder& g_recorder = Recorder::Instance();

}  // namespace

void RecordRun(const BoundSql& sql) {
    Recorder::Instance().TakeRun(sql.text);
}

}  // namespace zebtell::erp
