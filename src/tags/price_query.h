#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace zebtell::tags {

// The customer price query's text with its placeholders replaced, ignoring case and in this order:
// "#F" by `customer_key`, "#P" by `company`, "#H" by `price_list`, "#A" by `articles` (IDs
// separated by commas).
std::string BuildPriceQuery(std::string_view query_text,
                            std::int32_t company,
                            std::int32_t customer_key,
                            std::int32_t price_list,
                            std::string_view articles);

}  // namespace zebtell::tags
