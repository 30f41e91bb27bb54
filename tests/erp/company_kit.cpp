#include "tests/erp/company_kit.h"

#include <gtest/gtest.h>

#include <cstdlib>

#include "base/ignore_errors.h"
#include "base/runtime_error.h"
#include "erp/password.h"
#include "erp/sqlite/backend.h"
#include "tests/erp/odbc_sqlite.h"
#include "tests/erp/sqlite_file.h"
#include "tests/support/server_company.h"
#include "tests/support/server_sql_recorder.h"

namespace zebtell::erp {
namespace {

class WatchedConnection : public Connection {
  public:
    WatchedConnection(std::unique_ptr<Connection> inner, std::shared_ptr<Watch> watch)
        : inner_(std::move(inner)), watch_(std::move(watch)) {}

    std::unique_ptr<Cursor> Query(const BoundSql& sql) override {
        watch_->Statement();
        RecordRun(sql);
        return inner_->Query(sql);
    }
    void Execute(const BoundSql& sql) override {
        watch_->Statement();
        RecordRun(sql);
        inner_->Execute(sql);
    }
    std::int64_t Insert(const BoundSql& sql) override {
        watch_->Statement();
        RecordRun(sql);
        return inner_->Insert(sql);
    }
    void Begin() override {
        watch_->Statement();
        inner_->Begin();
    }
    void Commit() override {
        watch_->Statement();
        inner_->Commit();
        if (watch_->TakeLostAnswer()) {
            throw base::RuntimeError(base::errors::kUnspecified, "The answer was lost");
        }
    }
    void Rollback() noexcept override { inner_->Rollback(); }
    bool IsBroken() const override { return inner_->IsBroken(); }
    bool Answers() override { return inner_->Answers(); }
    DatabaseDescription Describe() override { return inner_->Describe(); }

  private:
    std::unique_ptr<Connection> inner_;
    std::shared_ptr<Watch> watch_;
};

class WatchedBackend : public Backend {
  public:
    WatchedBackend(std::unique_ptr<Backend> inner, std::shared_ptr<Watch> watch)
        : inner_(std::move(inner)), watch_(std::move(watch)) {}

    std::unique_ptr<Connection> Connect(Access access) override {
        return std::make_unique<WatchedConnection>(inner_->Connect(access), watch_);
    }
    std::unique_ptr<CommitWatch> WatchCommits() override { return inner_->WatchCommits(); }
    Dialect dialect() const override { return inner_->dialect(); }

  private:
    std::unique_ptr<Backend> inner_;
    std::shared_ptr<Watch> watch_;
};

class SqliteCompany : public Company {
  public:
    SqliteCompany() { std::filesystem::copy_file(Original(), path()); }

    data::DatabaseType type() const override { return data::DatabaseType::kSqlite; }
    std::string path() const override { return (folder_.path() / "company.db").string(); }
    std::unique_ptr<Backend> MakeBackend() const override {
        const sqlite::ConnectionLimits limits{.busy = std::chrono::milliseconds(100),
                                              .reading = std::chrono::milliseconds(500)};
        return std::make_unique<sqlite::SqliteBackend>(path(), limits);
    }

  protected:
    // Made once, copied for each test.
    static std::filesystem::path Original() {
        static const TempFolder folder;
        static const auto path = [] {
            auto file = folder.path() / "original.db";
            MakeSqliteFile(file, {"schema.sql", "views.sql"}, HashPassword("sala"));
            return file;
        }();
        return path;
    }

  private:
    TempFolder folder_;
};

class OdbcSqliteCompany : public SqliteCompany {
  public:
    OdbcSqliteCompany() : database_(SqliteCompany::path()) {}

    std::unique_ptr<Backend> MakeBackend() const override { return database_.MakeBackend(); }

  private:
    OdbcSqlite database_;
};

// A database of a real server, which holds nothing else; each test fills it anew.
class ServerCompany : public SqliteCompany {
  public:
    explicit ServerCompany(std::string path) : path_(std::move(path)) {
        const auto server = MakeBackend();
        DropCompany(*server);
        CopyCompany(Original(), *server);
    }
    ~ServerCompany() override {
        base::IgnoreErrors([this] { DropCompany(*MakeBackend()); });
    }
    ServerCompany(const ServerCompany&) = delete;
    ServerCompany& operator=(const ServerCompany&) = delete;

    data::DatabaseType type() const override { return data::DatabaseType::kSqlServer; }
    std::string path() const override { return path_; }
    std::unique_ptr<Backend> MakeBackend() const override {
        return erp::MakeBackend(type(), path_);
    }

  private:
    std::string path_;
};

}  // namespace

void Watch::Statement() {
    if (++count_ == fail_at_) {
        throw base::RuntimeError(base::errors::kUnspecified, "The connection was lost");
    }
}

std::unique_ptr<Backend> Watched(std::unique_ptr<Backend> backend, std::shared_ptr<Watch> watch) {
    return std::make_unique<WatchedBackend>(std::move(backend), std::move(watch));
}

void Company::Run(const std::string& sql) const {
    MakeBackend()->Connect(Access::kWrite)->Execute({sql, {}});
}

std::string Company::Show(const std::string& sql) const {
    const auto connection = MakeBackend()->Connect(Access::kRead);
    const auto cursor = connection->Query({sql, {}});
    std::string shown;
    while (cursor->Next()) {
        for (std::size_t i = 0; i < cursor->Columns().size(); ++i) {
            shown += (i == 0 ? "" : " ") + cursor->Get(i).ToPlainText();
        }
        shown += ";";
    }
    return shown;
}

std::vector<DatabaseKind> DatabaseKinds() {
    std::vector<DatabaseKind> kinds = {
        {"Sqlite", [] { return std::make_unique<SqliteCompany>(); }}};
    if (OdbcSqlite::IsInstalled()) {
        kinds.push_back({"OdbcSqlite", [] { return std::make_unique<OdbcSqliteCompany>(); }});
    }
    if (const char* path = std::getenv("ZEBTELL_TEST_ODBC")) {
        kinds.push_back({"SqlServer", [path] { return std::make_unique<ServerCompany>(path); }});
    }
    return kinds;
}

PortalTest::PortalTest() : company_(GetParam().make()) {
    const base::DateTime now = *base::DateTime::FromIso("2026-03-15 10:00:00");
    databases_ = std::make_unique<Databases>([now] { return now; },
                                             [this](data::DatabaseType, const std::string&) {
                                                 return Watched(company_->MakeBackend(), watch_);
                                             });
}

std::unique_ptr<data::DataApplication> PortalTest::LogOn(const std::string& user,
                                                         const std::string& password) {
    auto application = databases_->NewApplication();
    application->Initialise("ZEBTell", "WEBUser", "WEBGuest", "Külaline");
    user_ = application->Logon(company_->type(), company_->path(), user, password);
    return application;
}

std::string Text(data::Record& record, std::string_view field) {
    return record.GetField(field).ToPlainText();
}

int ErrorOf(const std::function<void()>& work) {
    try {
        work();
    } catch (const base::RuntimeError& error) {
        return error.number();
    }
    return 0;
}

}  // namespace zebtell::erp
