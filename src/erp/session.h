#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "base/clock.h"
#include "data/filter.h"
#include "erp/access.h"
#include "erp/company_database.h"
#include "erp/key_table.h"
#include "erp/linked_order.h"
#include "erp/row_set.h"

namespace zebtell::erp {

// A logged-on reader of a company database: what every list, record and document of one session
// reads through. Used by one thread at a time.
class Session {
  public:
    Session(std::shared_ptr<CompanyDatabase> database, Reader reader, base::Clock clock);

    CompanyDatabase& database() const { return *database_; }
    const Schema& schema() const { return database_->schema(); }
    const Reader& reader() const { return reader_; }
    const base::Clock& clock() const { return clock_; }

    // From now on the reader sees this document, which he has stored.
    void AddSavedDocument(std::int64_t id);

    // The keys of a table's rows, with the columns that its records were looked up by so far and
    // `find_column` ("": no other).
    std::shared_ptr<const KeyTable> Keys(const TableInfo& table,
                                         const data::Filter& filter,
                                         std::string_view order,
                                         std::string_view find_column = {});

    // The rows of these keys, in their order, with all fields that the table's records were asked
    // for so far and `field` ("": no other).
    std::shared_ptr<const RowSet> Rows(const TableInfo& table,
                                       std::span<const std::int64_t> ids,
                                       std::string_view field = {});

    // The result of a select statement.
    std::shared_ptr<const RowSet> Query(std::string_view sql);

  private:
    std::shared_ptr<const KeyTable> ReadKeys(const BoundSql& sql,
                                             const std::vector<std::string>& columns);
    std::shared_ptr<const KeyTable> InOrder(const std::shared_ptr<const KeyTable>& keys,
                                            const LinkedOrder& order);
    template <class Kept, class Read>
    std::shared_ptr<const Kept> Shared(const std::string& key, Read&& read);
    template <class Read>
    auto Run(const BoundSql& sql, Read&& read);
    std::string TableKey(const TableInfo& table) const;

    std::shared_ptr<CompanyDatabase> database_;
    Reader reader_;
    base::Clock clock_;
    std::string reader_key_;  // alike for readers who see the same
};

}  // namespace zebtell::erp
