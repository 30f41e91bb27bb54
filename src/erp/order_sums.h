#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "base/currency.h"
#include "base/value.h"

namespace zebtell::erp {

class Order;

// The tax of all rows of one percentage.
struct TaxLine {
    double percent = 0;
    base::Currency base;    // the rows' amounts
    base::Currency amount;  // the tax on them, to 2 decimals
};

struct OrderSums {
    base::Currency amount;
    base::Currency tax_amount;
    std::vector<TaxLine> taxes;  // by rising percentage

    base::Currency with_tax() const { return amount + tax_amount; }
};

// Of the rows as they are now.
OrderSums SumsOf(const Order& order);

// The value of a header field that is a sum, nothing for other fields.
std::optional<base::Value> HeaderSum(const Order& order, std::string_view field);

}  // namespace zebtell::erp
