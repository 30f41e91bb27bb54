#include "erp/odbc/connection.h"

#include "base/ignore_errors.h"
#include "base/runtime_error.h"
#include "erp/odbc/catalogue.h"
#include "erp/odbc/errors.h"
#include "erp/odbc/utf16.h"

namespace zebtell::erp::odbc {

// Drivers for SQL Server have one open result a connection; with another driver a second one would
// go unnoticed, so it is refused here.
class OdbcConnection::OpenCursor : public Cursor {
  public:
    OpenCursor(OdbcConnection& connection, std::string text, const std::vector<base::Value>& values)
        : connection_(connection), text_(std::move(text)) {
        connection.RefuseSecondResult();
        statement_ = connection.statements_.Take(text_);
        statement_->Run(values);
        connection.reading_ = true;
    }
    ~OpenCursor() override {
        connection_.reading_ = false;
        connection_.statements_.Give(text_, std::move(statement_));
    }
    OpenCursor(const OpenCursor&) = delete;
    OpenCursor& operator=(const OpenCursor&) = delete;

    const std::vector<std::string>& Columns() const override { return statement_->columns(); }
    bool Next() override { return statement_->Next(); }
    base::Value Get(std::size_t column) const override { return statement_->Get(column); }
    std::int64_t GetInteger(std::size_t column) const override {
        return statement_->GetInteger(column);
    }
    void Finish() { statement_->Finish(); }

  private:
    OdbcConnection& connection_;
    std::string text_;
    std::unique_ptr<Statement> statement_;
};

ConnectionHandle::ConnectionHandle(const Environment& environment,
                                   const std::string& connection_string,
                                   std::chrono::seconds limit)
    : handle_(environment.get()) {
    SQLSetConnectAttrW(handle_.get(),
                       SQL_ATTR_LOGIN_TIMEOUT,
                       AttributeValue(static_cast<std::size_t>(limit.count())),
                       0);
    std::u16string wide = ToUtf16(connection_string);
    SQLSMALLINT length = 0;
    const SQLRETURN code = SQLDriverConnectW(handle_.get(),
                                             nullptr,
                                             Wide(wide),
                                             static_cast<SQLSMALLINT>(wide.size()),
                                             nullptr,
                                             0,
                                             &length,
                                             SQL_DRIVER_NOPROMPT);
    if (!Succeeded(code)) {
        FailToConnect(handle_.get());
    }
}

OdbcConnection::OdbcConnection(std::shared_ptr<Environment> environment,
                               const std::string& connection_string,
                               const ServerKind& kind,
                               Access access,
                               const ConnectionLimits& limits)
    : environment_(std::move(environment)),
      handle_(*environment_, connection_string, limits.connect),
      link_{kind, limits, handle_.get()},
      statements_(
          [this](const std::string& text) { return std::make_unique<Statement>(link_, text); }) {
    Run(kind.set_up);
    Run(access == Access::kRead ? kind.set_up_read : kind.set_up_write);
}

void OdbcConnection::RefuseSecondResult() const {
    if (reading_) {
        throw base::RuntimeError(base::errors::kInvalidCall,
                                 "The connection's last result is still open");
    }
}

// Not prepared: to SQL Server a prepared statement is a procedure, which settings and transactions
// do not outlive.
void OdbcConnection::Run(const std::string& text) {
    if (text.empty()) {
        return;
    }
    RefuseSecondResult();
    Statement statement(link_);
    std::u16string wide = ToUtf16(text);
    statement.RunWith(
        [&wide](SQLHSTMT handle) { return SQLExecDirectW(handle, Wide(wide), SQL_NTS); });
    statement.Finish();
}

std::unique_ptr<Cursor> OdbcConnection::Query(const BoundSql& sql) {
    return std::make_unique<OpenCursor>(*this, sql.text, sql.values);
}

void OdbcConnection::Execute(const BoundSql& sql) {
    if (sql.values.empty()) {
        Run(sql.text);
    } else {
        OpenCursor(*this, sql.text, sql.values).Finish();
    }
}

std::int64_t OdbcConnection::Insert(const BoundSql& sql) {
    if (!link_.kind.insert_suffix.empty()) {
        return ReadKey({sql.text + link_.kind.insert_suffix, sql.values});
    }
    Execute(sql);
    return ReadKey({link_.kind.last_key, {}});
}

std::int64_t OdbcConnection::ReadKey(const BoundSql& sql) {
    OpenCursor cursor(*this, sql.text, sql.values);
    const std::int64_t key = cursor.Next() ? cursor.GetInteger(0) : 0;
    cursor.Finish();
    return key;
}

void OdbcConnection::Begin() {
    Run(link_.kind.begin);
}

void OdbcConnection::Commit() {
    Run(link_.kind.commit);
}

void OdbcConnection::Rollback() noexcept {
    if (!link_.broken && !base::IgnoreErrors([this] { Run(link_.kind.rollback); })) {
        link_.broken = true;
    }
}

bool OdbcConnection::Answers() {
    return !link_.broken && base::IgnoreErrors([this] { Execute({"SELECT 1", {}}); });
}

DatabaseDescription OdbcConnection::Describe() {
    return ReadCatalogue(link_);
}

}  // namespace zebtell::erp::odbc
