#pragma once

#include <cstdint>
#include <memory>

#include "erp/order.h"

namespace zebtell::erp {

// An unsaved order of the reader's company, with its defaults.
std::shared_ptr<Order> NewOrder(const std::shared_ptr<Session>& session);

// A stored order with its rows, null when the reader sees none of that number.
std::shared_ptr<Order> LoadOrder(const std::shared_ptr<Session>& session, std::int64_t id);

}  // namespace zebtell::erp
