#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "host/session_state.h"

namespace zebtell::tags {

// The customer price query's text with its placeholders replaced, ignoring case and in this order:
// "#F" by `customer_key`, "#P" by `company`, "#H" by `price_list`, "#A" by `articles` (IDs
// separated by commas).
std::string BuildPriceQuery(std::string_view query_text,
                            std::int32_t company,
                            std::int32_t customer_key,
                            std::int32_t price_list,
                            std::string_view articles);

// The customer's prices of these articles, by the price query of his session.
std::shared_ptr<data::RecordList> OpenCustomerPrices(const host::SessionState& state,
                                                     std::string_view articles);

}  // namespace zebtell::tags
