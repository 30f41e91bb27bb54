#pragma once

#include <cstdint>
#include <memory>
#include <string_view>

#include "erp/order.h"

namespace zebtell::erp {

// An unsaved order of the reader's company, with its defaults.
std::shared_ptr<Order> NewOrder(const std::shared_ptr<Session>& session);

// A stored order with its rows, null when the reader sees none of that number.
std::shared_ptr<Order> LoadOrder(const std::shared_ptr<Session>& session, std::int64_t id);

// The stored order of the reader's company that was made with this key, 0 when there is none. The
// reader sees it from now on, a guest too: only who has made an order knows its key.
std::int64_t FindOrder(Session& session, std::string_view key);

}  // namespace zebtell::erp
