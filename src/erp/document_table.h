#pragma once

#include <memory>
#include <string_view>

#include "data/document.h"
#include "erp/session.h"

namespace zebtell::erp {

// A table's documents for editing. RuntimeError 5 for a table that holds none.
std::shared_ptr<data::Table> OpenDocumentTable(const std::shared_ptr<Session>& session,
                                               const TableInfo& table,
                                               const data::Filter& filter);

}  // namespace zebtell::erp
