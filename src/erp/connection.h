#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "base/runtime_error.h"
#include "base/text.h"
#include "base/value.h"
#include "erp/bound_sql.h"
#include "erp/schema.h"

namespace zebtell::erp {

// A statement failed, and the same may well succeed when it is run again.
class TransientError : public base::RuntimeError {
  public:
    enum class Kind {
        kConnectionLost,  // whether the statement was carried out is not known
        kDeadlock,        // the database has rolled the transaction back in favour of another one
    };

    TransientError(Kind kind, const std::string& description)
        : RuntimeError(base::errors::kUnspecified, description), kind_(kind) {}

    Kind kind() const { return kind_; }

  private:
    Kind kind_;
};

// The database refuses the name or the password that a connection is made with.
class LoginRefused : public base::RuntimeError {
  public:
    LoginRefused() : RuntimeError(base::errors::kUnspecified, "The database refuses the log-on") {}
};

// The result of a statement, read row by row. It frees its statement when it is destroyed and does
// not outlive its connection.
class Cursor {
  public:
    virtual ~Cursor() = default;

    virtual const std::vector<std::string>& Columns() const = 0;
    virtual bool Next() = 0;  // before the first row, too
    // The value as the column's declared type says, of the row that Next reached.
    virtual base::Value Get(std::size_t column) const = 0;
    virtual std::int64_t GetInteger(std::size_t column) const = 0;  // null: 0
};

// What a database says of itself.
struct DatabaseDescription {
    std::vector<TableInfo> tables;
    // The most characters that text columns take, by "table.column"; no entry: no limit.
    std::unordered_map<std::string, int, base::NoCaseHash, base::NoCaseEqual> lengths;
};

// What a connection is for. Reading connections can't write and end statements that take too long.
enum class Access { kRead, kWrite };

// One connection to a company database, used by one thread at a time, with one open cursor at a
// time. Errors are RuntimeErrors that name no file and no server.
class Connection {
  public:
    virtual ~Connection() = default;

    virtual std::unique_ptr<Cursor> Query(const BoundSql& sql) = 0;
    virtual void Execute(const BoundSql& sql) = 0;
    // Runs an insert and gives the key that the database has given the new row.
    virtual std::int64_t Insert(const BoundSql& sql) = 0;

    // Begin takes the right to write at once, so that what is read afterwards stays true.
    virtual void Begin() = 0;
    virtual void Commit() = 0;
    virtual void Rollback() noexcept = 0;  // also when there is nothing to roll back

    // Of no more use: a connection that was lost, or that may still be busy with something.
    virtual bool IsBroken() const { return false; }
    // Asks the database for a sign of life, which costs a round trip.
    virtual bool Answers() { return true; }
    virtual DatabaseDescription Describe() = 0;
};

// Tells when cached results may be out of date. Used by one thread at a time.
class CommitWatch {
  public:
    virtual ~CommitWatch() = default;

    // A number that is another one when somebody may have committed something since. Only numbers
    // of the same watch compare.
    virtual std::int64_t DataVersion() = 0;
};

// A company database of one kind: all that differs between the kinds. Thread-safe.
class Backend {
  public:
    virtual ~Backend() = default;

    // RuntimeError kUnspecified when the database is not there.
    virtual std::unique_ptr<Connection> Connect(Access access) = 0;
    virtual std::unique_ptr<CommitWatch> WatchCommits() = 0;
    virtual Dialect dialect() const = 0;
};

}  // namespace zebtell::erp
