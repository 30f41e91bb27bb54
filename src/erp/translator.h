#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "data/filter.h"
#include "erp/access.h"
#include "erp/bound_sql.h"
#include "erp/schema.h"

namespace zebtell::erp {

// Turns what pages ask for (filters, orders, dotted paths, select statements) into statements of
// one database. Every text is parsed; every table in it, also in subqueries, stands for the rows
// of it that the reader may see; hidden columns do not exist. What does not parse or names what
// the reader may not read throws RuntimeError kStatementFailed (kNoSuchTable for a table), with
// the offending text HTML-escaped in its description.
class Translator {
  public:
    Translator(const Schema& schema, Dialect dialect) : schema_(schema), dialect_(dialect) {}

    // select ID [, columns...] from `table` where filter order by order, ID.
    // `columns` are columns of the table that are fetched beside the key.
    BoundSql ListKeys(const Reader& reader,
                      std::string_view table,
                      const data::Filter& filter,
                      std::string_view order,
                      std::span<const std::string> columns) const;

    // select ID, fields... from `table` where its ID is one of `ids`, in no particular order.
    // A field is a column or a dotted path ("GRArticle.GRTax.TaxPercent"); links are left joins.
    BoundSql RowsByID(const Reader& reader,
                      std::string_view table,
                      std::span<const std::int64_t> ids,
                      std::span<const std::string> fields) const;

    // A select statement that a page or template wrote. Long lists of whole numbers after "in"
    // become one value, so that the text repeats.
    BoundSql Select(const Reader& reader, std::string_view sql) const;

    // The columns of a table that the reader may read, in the table's order.
    std::vector<std::string> ReadableColumns(const Reader& reader, std::string_view table) const;

  private:
    const Schema& schema_;
    Dialect dialect_;
};

}  // namespace zebtell::erp
