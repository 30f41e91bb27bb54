#include "erp/order_sums.h"

#include <map>

#include "base/text.h"
#include "erp/order.h"

namespace zebtell::erp {

OrderSums SumsOf(const Order& order) {
    std::map<double, base::Currency> bases;
    for (const auto& row : order.rows) {
        if (row->IsToStore()) {
            bases[row->fields.Number("TaxPercent")] += row->fields.Money("Amount");
        }
    }
    OrderSums sums;
    for (const auto& [percent, base] : bases) {
        sums.taxes.push_back({percent, base, base::PercentOf(base, percent, 2)});
        sums.amount += base;
        sums.tax_amount += sums.taxes.back().amount;
    }
    return sums;
}

std::optional<base::Value> HeaderSum(const Order& order, std::string_view field) {
    if (base::EqualNoCase(field, "Amount")) {
        return SumsOf(order).amount;
    }
    if (base::EqualNoCase(field, "TaxAmount")) {
        return SumsOf(order).tax_amount;
    }
    if (base::EqualNoCase(field, "AmountWTax")) {
        return SumsOf(order).with_tax();
    }
    return std::nullopt;
}

}  // namespace zebtell::erp
