#pragma once

#include <gtest/gtest.h>
#include <sqlite3.h>

#include <fstream>
#include <iterator>
#include <memory>
#include <stdexcept>
#include <string>

#include "app/portal.h"
#include "erp/password.h"
#include "tests/portal/browser.h"
#include "tests/support/source_folder.h"
#include "tests/support/temp_folder.h"

namespace zebtell {

// The company database of a test, beside the portal.
class CompanyFile {
  public:
    explicit CompanyFile(const std::filesystem::path& file) {
        if (sqlite3_open(file.c_str(), &connection_) != SQLITE_OK) Fail();
        sqlite3_busy_timeout(connection_, 5000);
    }
    ~CompanyFile() { sqlite3_close(connection_); }
    CompanyFile(const CompanyFile&) = delete;
    CompanyFile& operator=(const CompanyFile&) = delete;

    // The rows of a statement: values joined with "|", each row ends with a line break.
    std::string Run(const std::string& sql) {
        std::string rows;
        const auto append = [](void* out, int count, char** values, char**) {
            std::string& text = *static_cast<std::string*>(out);
            for (int i = 0; i < count; ++i) {
                if (i != 0) text += '|';
                text += values[i] == nullptr ? "NULL" : values[i];
            }
            text += '\n';
            return 0;
        };
        if (sqlite3_exec(connection_, sql.c_str(), append, &rows, nullptr) != SQLITE_OK) Fail();
        return rows;
    }

  private:
    [[noreturn]] void Fail() { throw std::runtime_error(sqlite3_errmsg(connection_)); }

    sqlite3* connection_ = nullptr;
};

inline std::string ReadFile(const std::filesystem::path& file) {
    std::ifstream in(file, std::ios::binary);
    if (!in) throw std::runtime_error("cannot read " + file.string());
    return {std::istreambuf_iterator<char>(in), {}};
}

// The portal with the small company and plain templates, on a free port, at 2026-11-21 14:05:09.
class PortalTest : public ::testing::Test {
  protected:
    static constexpr const char* kUsualSettings = "[Session]\r\nBlocking=3\r\nTimeout=5\r\n";

    void SetUp() override {
        const std::filesystem::path source = SourceFolder();
        std::string script = "PRAGMA synchronous = OFF; BEGIN;";
        for (const char* file : {"database/sqlite/schema.sql",
                                 "database/sqlite/views.sql",
                                 "tests/portal/company.sql"}) {
            script += ReadFile(source / file);
        }
        company().Run(script + SetPasswords() + "COMMIT;");
        std::filesystem::copy(source / "tests/portal/templates", folder.path() / "templates");
        Start(kUsualSettings);
    }

    // Starts the portal anew, with further settings.
    void Start(const std::string& settings) {
        StartOn("Path=" + (folder.path() / "company.db").string(), settings);
    }
    // The same with another database.
    void StartOn(const std::string& database, const std::string& settings) {
        portal.reset();
        folder.Write("ZEBTell.ini",
                     "[DataBase]\r\n" + database + "\r\n[WEBLog]\r\nLevel=Detail\r\n" + settings);
        host::ServerSettings server;
        server.Port = 0;
        server.Threads = 4;
        server.TemplateFolder = folder.path() / "templates";
        portal = std::make_unique<app::Portal>(folder.path(), server, [this] { return now; });
    }

    Browser NewBrowser() const { return Browser(portal->port()); }
    Browser MariLoggedOn() const {
        Browser browser = NewBrowser();
        browser.LogOn("mari", "mari-sala");
        return browser;
    }
    CompanyFile company() const { return CompanyFile(folder.path() / "company.db"); }
    std::string Log() const { return folder.Read("ZEBTell.log"); }

    TempFolder folder;
    base::DateTime now = *base::DateTime::FromIso("2026-11-21 14:05:09");
    std::unique_ptr<app::Portal> portal;

  private:
    static std::string SetPasswords() {
        // Hashing costs time on purpose: once for all tests.
        static const std::string kMari = erp::HashPassword("mari-sala");
        static const std::string kNone = erp::HashPassword("");
        return "UPDATE SYUser SET PasswordHash = '" + kMari +
               "' WHERE Guest = 0; UPDATE SYUser SET PasswordHash = '" + kNone +
               "' WHERE Guest = 1;";
    }
};

}  // namespace zebtell
