#include "demo/trade_document.h"

#include <algorithm>

namespace zebtell::demo {

DocumentSums SumsOf(const std::vector<TradeRow>& rows) {
    DocumentSums sums;
    for (const TradeRow& row : rows) {
        const double percent = row.article->tax_percent;
        const auto has_percent = [percent](const TaxLine& line) { return line.percent == percent; };
        auto line = std::find_if(sums.taxes.begin(), sums.taxes.end(), has_percent);
        if (line == sums.taxes.end()) {
            line = sums.taxes.insert(line, TaxLine{percent, {}, {}});
        }
        line->base += row.amount;
        sums.amount += row.amount;
    }
    for (TaxLine& line : sums.taxes) {
        line.amount = base::PercentOf(line.base, line.percent, 2);
        sums.tax += line.amount;
    }
    std::sort(sums.taxes.begin(), sums.taxes.end(), [](const TaxLine& a, const TaxLine& b) {
        return a.percent > b.percent;
    });
    return sums;
}

}  // namespace zebtell::demo
