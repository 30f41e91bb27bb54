#pragma once

#include "data/document.h"
#include "erp/order.h"

namespace zebtell::erp {

// Stores the order in one transaction, all or nothing; the order in memory is changed only when
// that has succeeded. An unsaved order whose key is in the database takes the stored ID and number.
// RuntimeError 5 when there is nothing to store, when staff have begun to process the stored order
// or somebody has changed it.
data::Saved SaveOrder(Order& order);

}  // namespace zebtell::erp
