#include "erp/order_price.h"

#include "base/decimal.h"

namespace zebtell::erp {
namespace {

std::string Joined(const std::vector<std::int64_t>& ids) {
    std::string text;
    for (const std::int64_t id : ids) {
        text += text.empty() ? "" : ",";
        text += std::to_string(id);
    }
    return text.empty() ? "0" : text;
}

OwnPrice PriceOf(const RowSet& rows, std::size_t row) {
    const auto number = [&](std::size_t column) {
        const base::Value& value = rows.Get(row, column);
        return value.IsNull() ? 0 : value.ToDouble();
    };
    OwnPrice own;
    own.price_cut = number(3);
    own.tax_percent = number(4);
    own.price = PriceWithCut(rows.Get(row, 2).ToCurrency(), own.price_cut);
    return own;
}

}  // namespace

base::Currency PriceWithCut(base::Currency list_price, double price_cut) {
    constexpr int kScale = base::Currency::kDecimals;
    constexpr std::int64_t kCent = base::Currency::kScale / 100;
    const auto hundred = base::Currency::FromScaled(100 * base::Currency::kScale);
    const base::Currency percent = hundred + base::Currency::FromDouble(price_cut);
    // Price times percent counts in cents.
    const base::Decimal cents = base::Decimal::FromInteger(list_price.scaled(), kScale) *
                                base::Decimal::FromInteger(percent.scaled(), kScale);
    const std::int64_t whole = cents.RoundedTo(0, base::Half::kAwayFromZero).ToScaled(0);
    return base::Currency::FromScaled(whole * kCent);
}

std::string OwnPricesSql(const Reader& reader, const std::vector<std::int64_t>& articles) {
    return "select s5.IDGRArticle, s5.IDGRPriceList, s5.Price, rel.PriceCut, t.TaxPercent"
           " from SQPriceList5 s5"
           " inner join GRArticle a on a.ID = s5.IDGRArticle"
           " left join GRTax t on t.ID = a.IDGRTax"
           " left join GRCompany c on c.ID = " +
           std::to_string(reader.partner) +
           " left join GRPriceCatRel rel on rel.IDGRCompanyPriceCat = c.IDGRCompanyPriceCat"
           " and rel.IDGRArticlePriceCat = a.IDGRArticlePriceCat"
           " and rel.IDGRPriceList = s5.IDSrcPriceList"
           " where s5.IDGRPriceList in (" +
           Joined(reader.price_lists) + ") and s5.IDGRArticle in (" + Joined(articles) + ")";
}

OwnPrices ReadOwnPrices(const Reader& reader, const RowSet& rows) {
    OwnPrices prices;
    for (const std::int64_t list : reader.price_lists) {
        for (std::size_t row = 0; row < rows.count(); ++row) {
            if (rows.Get(row, 1).ToInteger64() == list) {
                prices.try_emplace(rows.Get(row, 0).ToInteger64(), PriceOf(rows, row));
            }
        }
    }
    return prices;
}

}  // namespace zebtell::erp
