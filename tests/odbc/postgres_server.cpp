#include "tests/odbc/postgres_server.h"

#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <stdexcept>

namespace zebtell::erp {
namespace {

const odbc::ServerKind kKind{.dialect = Dialect::kSqlServer,
                             .set_up = "",
                             .set_up_read = "SET default_transaction_read_only = on",
                             .set_up_write = "",
                             .begin = "BEGIN",
                             .commit = "COMMIT",
                             .rollback = "ROLLBACK",
                             .insert_suffix = " RETURNING id",
                             .last_key = "",
                             .loose_types = false};

int FreePort() {
    const int probe = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t size = sizeof address;
    bind(probe, reinterpret_cast<sockaddr*>(&address), size);
    getsockname(probe, reinterpret_cast<sockaddr*>(&address), &size);
    close(probe);
    return ntohs(address.sin_port);
}

// The folder of the newest version, "" for none.
std::string Programs() {
    std::string newest;
    std::error_code ignored;
    for (const auto& version :
         std::filesystem::directory_iterator("/usr/lib/postgresql", ignored)) {
        newest = std::max(newest, (version.path() / "bin").string());
    }
    return newest;
}

}  // namespace

bool PostgresServer::IsInstalled() {
    return !Programs().empty() && std::filesystem::exists(ZEBTELL_POSTGRES_ODBC);
}

PostgresServer::PostgresServer() : data_((folder_.path() / "data").string()), port_(FreePort()) {
    folder_.Write("password", "sala");
    if (geteuid() == 0 &&
        std::system(("chown -R postgres " + folder_.path().string()).c_str()) != 0) {
        throw std::runtime_error("The server's folder can't be given to its user");
    }
    Run("initdb -D " + data_ + " -U portal -A scram-sha-256 --pwfile=" +
        (folder_.path() / "password").string() + " -E UTF8 --locale=C --no-sync");
    Start();
}

PostgresServer::~PostgresServer() {
    Stop();
}

void PostgresServer::Start() {
    Run("pg_ctl -D " + data_ + " -w -l " + data_ + "/log -o '-p " + std::to_string(port_) + " -k " +
        data_ + " -c listen_addresses=127.0.0.1 -c fsync=off'" + " start");
}

void PostgresServer::Stop() {
    // Also when it is not running.
    const std::string command = "pg_ctl -D " + data_ + " -w -m immediate stop || true";
    Run(command);
}

odbc::OdbcBackend PostgresServer::Backend(const std::string& user,
                                          const std::string& password) const {
    return odbc::OdbcBackend(
        std::string("Driver=") + ZEBTELL_POSTGRES_ODBC +
            ";Servername=127.0.0.1;Port=" + std::to_string(port_) +
            ";Database=postgres;BoolsAsChar=0;UID=" + user + ";PWD=" + password,
        kKind,
        {.connect = std::chrono::seconds(3), .statement = std::chrono::seconds(1)});
}

void PostgresServer::Run(const std::string& command) const {
    const std::string as_user =
        geteuid() == 0 ? "setpriv --reuid=postgres --regid=postgres --clear-groups " : "";
    const std::string line = "cd / && " + as_user + "env PATH=" + Programs() + ":$PATH sh -c \"" +
                             command + "\" >/dev/null 2>&1";
    if (std::system(line.c_str()) != 0) {
        throw std::runtime_error("This failed: " + command);
    }
}

}  // namespace zebtell::erp
