#pragma once

#include "erp/connection.h"
#include "erp/order.h"

namespace zebtell::erp {

// Whether a row is asked for less than the customer's own price as the database has it now. Such
// an order is stored as it was asked for, and staff look at it.
bool NeedsReview(const Order& order, Connection& connection);

}  // namespace zebtell::erp
