#pragma once

#include <cstdint>
#include <memory>

#include "erp/connection.h"
#include "erp/order.h"

namespace zebtell::erp {

// The stored order as this connection sees it now; nothing when the reader sees none.
std::optional<OrderImage> ReadOrderImage(const Translator& translator,
                                         const Reader& reader,
                                         Connection& connection,
                                         std::int64_t id);

bool IsSame(const OrderImage& a, const OrderImage& b);

}  // namespace zebtell::erp
