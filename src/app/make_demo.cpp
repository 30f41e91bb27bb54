#include <chrono>
#include <fstream>
#include <iostream>

#include "app/commands.h"
#include "base/runtime_error.h"
#include "erp/odbc/backend.h"
#include "host/settings.h"

namespace zebtell::app {
namespace {

namespace fs = std::filesystem;

constexpr std::chrono::seconds kConnectLimit{5};
constexpr std::chrono::seconds kIndexLimit{600};  // one index of a large company

constexpr std::string_view kLogons =
    "Log on with one of these:\n"
    "  mari   mari-demo    customer with discounts and a contact person\n"
    "  janis  janis-demo   Latvian customer on another price list\n"
    "  blokk  blokk-demo   customer who may look, not order\n"
    "  (no name, no password: guest)\n";

void WriteSettings(const fs::path& file) {
    std::ofstream out(file, std::ios::binary);
    out << "; Settings of the demo company; the operations manual explains every key.\r\n"
           "; Paths count from this file's folder.\r\n"
           "[DataBase]\r\nPath=company.db\r\nType=SQLite\r\nLanguage=EST\r\n\r\n"
           "[WebGuest]\r\nDispName=Külaline\r\nUserID=WebGuest\r\nPassWord=\r\n\r\n"
           "[WEBLog]\r\nLogFile=ZEBTell.log\r\nLevel=Detail\r\n\r\n"
           "[Session]\r\nBlocking=5\r\nTimeout=5\r\n\r\n"
           "[Server]\r\nAddress=127.0.0.1\r\nPort=8080\r\n";
    if (!out.flush()) {
        throw base::RuntimeError(base::errors::kUnspecified, "ZEBTell.ini can't be written");
    }
}

// The settings name a database on a server: that is where the company goes.
bool MakeOnServer(const fs::path& folder, const demo::DemoOptions& options) {
    const host::Settings settings = host::LoadSettings(folder);
    if (settings.Type == data::DatabaseType::kSqlite) return false;
    std::cout << "Making the demo company in the database that ZEBTell.ini names" << std::endl;
    erp::odbc::OdbcBackend server(settings.Path,
                                  erp::odbc::SqlServer(),
                                  {.connect = kConnectLimit, .statement = kIndexLimit});
    demo::MakeDemoCompany(server, options);
    std::cout << kLogons;
    return true;
}

}  // namespace

int MakeDemo(const fs::path& folder, const demo::DemoOptions& options) {
    fs::create_directories(folder);
    if (MakeOnServer(folder, options)) return 0;
    const fs::path database = folder / "company.db";
    if (!fs::exists(database)) {
        std::cout << "Making the demo company in " << folder.string() << std::endl;
        demo::MakeDemoCompany(database, options);
    }
    const fs::path settings = folder / "ZEBTell.ini";
    if (!fs::exists(settings)) WriteSettings(settings);
    std::cout << kLogons;
    return 0;
}

}  // namespace zebtell::app
