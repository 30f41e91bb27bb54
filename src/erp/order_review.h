#pragma once

#include <optional>
#include <vector>

#include "base/currency.h"
#include "erp/connection.h"
#include "erp/order.h"

namespace zebtell::erp {

// For each row of the order that is asked for less than the customer's own price as the database
// has it now: that price per unit, 0 where he has none. Nothing for the other rows. An order with
// such a row is stored as it was asked for, and staff look at it.
std::vector<std::optional<base::Currency>> ReviewPrices(const Order& order, Connection& connection);

}  // namespace zebtell::erp
