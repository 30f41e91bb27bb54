#include "erp/odbc/backend.h"

#include <chrono>

#include "erp/odbc/connection_string.h"

namespace zebtell::erp::odbc {
namespace {

class ClockWatch : public CommitWatch {
  public:
    std::int64_t DataVersion() override {
        const auto now = std::chrono::steady_clock::now().time_since_epoch();
        return std::chrono::duration_cast<std::chrono::seconds>(now).count();
    }
};

std::shared_ptr<Environment> MakeEnvironment() {
    auto environment = std::make_shared<Environment>(SQLHANDLE{});
    SQLSetEnvAttr(environment->get(), SQL_ATTR_ODBC_VERSION, AttributeValue(SQL_OV_ODBC3), 0);
    return environment;
}

}  // namespace

OdbcBackend::OdbcBackend(std::string_view path,
                         const ServerKind& kind,
                         const ConnectionLimits& limits)
    : connection_string_(ConnectionString(path)),
      kind_(kind),
      limits_(limits),
      environment_(MakeEnvironment()) {}

std::unique_ptr<Connection> OdbcBackend::Connect(Access access) {
    return std::make_unique<OdbcConnection>(
        environment_, connection_string_, kind_, access, limits_);
}

std::unique_ptr<CommitWatch> OdbcBackend::WatchCommits() {
    return std::make_unique<ClockWatch>();
}

}  // namespace zebtell::erp::odbc
