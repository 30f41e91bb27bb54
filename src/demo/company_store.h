#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string_view>
#include <variant>
#include <vector>

#include "base/currency.h"
#include "base/date_time.h"

namespace zebtell::demo {

// A value of a row; monostate is null. Texts live until the row is written.
using Cell = std::
    variant<std::monostate, std::int64_t, double, base::Currency, base::DateTime, std::string_view>;

// Writes the rows of one table.
class RowWriter {
  public:
    virtual ~RowWriter() = default;

    // The values in the order of the columns.
    virtual void Write(std::span<const Cell> row) = 0;
};

// A new database that is being filled with a company: its tables are there, and its rows come in no
// order that links would ask for. Database errors throw RuntimeError.
class CompanyStore {
  public:
    virtual ~CompanyStore() = default;

    // Lives as long as the store.
    virtual RowWriter& Table(std::string_view name,
                             const std::vector<std::string_view>& columns) = 0;
};

// A link column: 0 is stored as null.
struct Link {
    std::int64_t id = 0;
};

// The rows of one table, each given as its values.
class Insert {
  public:
    Insert(CompanyStore& store,
           std::string_view table,
           const std::vector<std::string_view>& columns)
        : writer_(store.Table(table, columns)) {}

    // One row; the values are given in the order of the columns.
    template <class... Values>
    void Row(const Values&... values) {
        const Cell row[] = {CellOf(values)...};
        writer_.Write(row);
    }

  private:
    static Cell CellOf(std::int64_t number) { return number; }
    static Cell CellOf(int number) { return std::int64_t{number}; }
    static Cell CellOf(double number) { return number; }
    static Cell CellOf(base::Currency amount) { return amount; }
    static Cell CellOf(base::DateTime date) { return date; }
    static Cell CellOf(Link link) { return link.id == 0 ? Cell() : Cell(link.id); }
    static Cell CellOf(std::string_view text) { return text.empty() ? Cell() : Cell(text); }

    RowWriter& writer_;
};

}  // namespace zebtell::demo
