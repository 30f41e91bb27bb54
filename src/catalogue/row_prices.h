#pragma once

#include <string>
#include <string_view>

#include "host/session_state.h"

namespace zebtell::catalogue {

// A field of the catalogue's current row as HTML: list price, the customer's own price, either
// with 18 per cent tax, or any other field. "" when there is no row.
std::string RowField(const host::SessionState& state, std::string_view field);

// A field of the customer's prices for the current row; FinalPriceWTax is the own price with the
// article's tax. "" when there are none.
std::string PriceField(const host::SessionState& state, std::string_view field);

}  // namespace zebtell::catalogue
