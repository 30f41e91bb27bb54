#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "erp/key_table.h"
#include "erp/schema.h"

namespace zebtell::erp {

// An order by one column of a linked table ("GRArticle.Code desc"). The database would sort every
// such list anew with a look-up a row; instead the list is read in the order of its keys, and put
// into the order of the linked records, which all lists share.
struct LinkedOrder {
    const Column* link = nullptr;       // the list's column
    const TableInfo* target = nullptr;  // the linked records' table
    std::string order;                  // of the linked records: "Code desc"
    bool descending = false;
};

// Nothing for an order of another kind. RuntimeError kStatementFailed for a text that is none.
std::optional<LinkedOrder> FindLinkedOrder(const Schema& schema,
                                           const TableInfo& table,
                                           std::string_view order);

// The list in the order in which the records of its column `link` stand in `linked`. Rows of one
// record stay as they are; rows without one count as null: the first, descending the last.
std::shared_ptr<const KeyTable> ArrangedByLink(const KeyTable& list,
                                               std::size_t link,
                                               const KeyTable& linked,
                                               bool descending);

}  // namespace zebtell::erp
