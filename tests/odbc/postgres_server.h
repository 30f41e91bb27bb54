#pragma once

#include <string>

#include "erp/odbc/backend.h"
#include "tests/support/temp_folder.h"

namespace zebtell::erp {

// A PostgreSQL server of the test's own, on a free port, that is gone with the object: a real
// server behind a real driver, whose connections can be cut and whose statements lock one another
// out.
class PostgresServer {
  public:
    PostgresServer();
    ~PostgresServer();
    PostgresServer(const PostgresServer&) = delete;
    PostgresServer& operator=(const PostgresServer&) = delete;

    static bool IsInstalled();

    void Start();
    void Stop();  // at once, as by a power cut

    // "portal" is the administrator.
    odbc::OdbcBackend Backend(const std::string& user = "portal",
                              const std::string& password = "sala") const;

  private:
    // As a user who is not root, since the server refuses to run as root.
    void Run(const std::string& command) const;

    TempFolder folder_;
    std::string data_;
    int port_;
};

}  // namespace zebtell::erp
