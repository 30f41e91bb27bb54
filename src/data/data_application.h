#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "data/document.h"
#include "data/filter.h"
#include "data/record.h"
#include "data/record_list.h"

namespace zebtell::data {

// Database kinds as the settings number them.
enum class DatabaseType : int { kSqlite = 1, kSqlServer = 2 };

// The connection of one logged-on user to the company database. What he may read and write is
// decided here, whatever text asks for it. One per session; used by one thread at a time.
class DataApplication {
  public:
    virtual ~DataApplication() = default;

    // Who is asking, before the log-on: the name for the database, the roles that decide the
    // access of named users and of guests, and the guest's name for people.
    virtual void Initialise(std::string_view application,
                            std::string_view user_role,
                            std::string_view guest_role,
                            std::string_view guest_name) = 0;

    // The user's record (SYUser, "Partner" leads to his company). RuntimeError kLogonFailed for an
    // unknown or disabled user or a wrong password, kUnspecified when the database is not there.
    // Takes some 20 ms of processor time on purpose.
    virtual std::shared_ptr<Record> Logon(DatabaseType type,
                                          std::string_view path,
                                          std::string_view user,
                                          std::string_view password) = 0;

    // The record of that ID, or none when there is none that this user may see.
    virtual std::shared_ptr<Record> Load(std::string_view table, std::int64_t id) = 0;

    // A list of a table or view. `filter` is an SQL condition in braces, or text of the runtime's
    // own filter syntax, or empty; `order` is columns or dotted paths, each with an optional
    // "asc" or "desc", separated by commas, or empty.
    virtual std::shared_ptr<RecordList> OpenList(std::string_view table,
                                                 const Filter& filter,
                                                 std::string_view order) = 0;

    // The result of a select statement. The two numbers are kept for the runtime and are 0.
    virtual std::shared_ptr<RecordList> OpenQuery(std::string_view sql, int, int) = 0;

    // The table's documents for editing.
    virtual std::shared_ptr<Table> OpenTable(std::string_view table, const Filter& filter = {}) = 0;

    // The ID of the record of `linked` that new documents of `table` use by default, 0 for none:
    // DefaultLink("SDOrder", "GRPriceList").
    virtual std::int64_t DefaultLink(std::string_view table, std::string_view linked) = 0;
};

using DataApplicationFactory = std::function<std::unique_ptr<DataApplication>()>;

}  // namespace zebtell::data
