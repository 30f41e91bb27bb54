#pragma once

#include <memory>
#include <vector>

#include "erp/odbc/cell.h"
#include "erp/odbc/link.h"

namespace zebtell::erp::odbc {

// The rows of a statement that was run.
class Rows {
  public:
    virtual ~Rows() = default;

    virtual void Restart() {}  // the statement was run again
    virtual bool Next() = 0;
    virtual base::Value Get(std::size_t column) const = 0;
    virtual std::int64_t GetInteger(std::size_t column) const = 0;
};

// Reads many rows at a time into buffers, or, when a column's values may be of any length, row by
// row and value by value.
std::unique_ptr<Rows> MakeRows(Link& link,
                               SQLHSTMT statement,
                               const std::vector<ResultColumn>& columns);

}  // namespace zebtell::erp::odbc
