#include "erp/sqlite/backend.h"

namespace zebtell::erp::sqlite {
namespace {

// A connection that only looks.
class FileWatch : public CommitWatch {
  public:
    FileWatch(const std::string& path, const ConnectionLimits& limits)
        : connection_(path, Access::kRead, limits) {}

    std::int64_t DataVersion() override { return connection_.DataVersion(); }

  private:
    SqliteConnection connection_;
};

}  // namespace

std::unique_ptr<Connection> SqliteBackend::Connect(Access access) {
    return std::make_unique<SqliteConnection>(path_, access, limits_);
}

std::unique_ptr<CommitWatch> SqliteBackend::WatchCommits() {
    return std::make_unique<FileWatch>(path_, limits_);
}

}  // namespace zebtell::erp::sqlite
