#pragma once

#include <memory>
#include <string>
#include <vector>

#include "erp/odbc/errors.h"
#include "erp/odbc/link.h"
#include "erp/odbc/parameters.h"
#include "erp/odbc/rows.h"

namespace zebtell::erp::odbc {

// A prepared statement. What its columns are is known when it has been run, since some drivers
// prepare with the types of the values.
class Statement {
  public:
    Statement(Link& link, const std::string& text);
    // Without a text, for RunWith.
    explicit Statement(Link& link);

    // Runs what `call`(SQLHSTMT) asks of the driver, such as a catalogue function.
    template <class Call>
    void RunWith(const Call& call) {
        Check(link_, handle_.get(), call(handle_.get()));
        TakeColumns();
    }
    void Run(const std::vector<base::Value>& values);
    void Reset();  // closes the result

    // Of the first result that has columns.
    const std::vector<std::string>& columns() const { return names_; }
    bool Next() { return rows_ && rows_->Next(); }
    base::Value Get(std::size_t column) const { return rows_->Get(column); }
    std::int64_t GetInteger(std::size_t column) const { return rows_->GetInteger(column); }
    // The results behind the first are read for the errors in them.
    void Finish();

  private:
    void TakeColumns();
    SQLSMALLINT SkipToColumns();
    std::vector<ResultColumn> Describe(SQLSMALLINT count);
    ResultColumn DescribeColumn(SQLUSMALLINT column);
    std::string TypeName(SQLUSMALLINT column);

    Link& link_;
    Handle<SQL_HANDLE_STMT> handle_;
    Parameters parameters_;
    std::vector<ResultColumn> columns_;
    std::vector<std::string> names_;
    std::unique_ptr<Rows> rows_;
};

}  // namespace zebtell::erp::odbc
