#pragma once

#include <string>

namespace zebtell::data {

// The customer price query that a session starts with: each article's price line in the customer's
// list, the percentage of his price category for the article's, and the price that follows. A
// template may replace it.
std::string DefaultPriceQueryText();

}  // namespace zebtell::data
