#include "catalogue/row_prices.h"

#include "base/text.h"
#include "tags/custom_func.h"
#include "tags/fixed_tax.h"

namespace zebtell::catalogue {
namespace {

std::string Fixed(std::string_view field) {
    return std::string(field) + ";fixed";
}

std::string FinalPrice18(data::Record& prices, const base::Region& region) {
    return tags::FixedPrice(prices.GetField("FinalPrice"), tags::kTax18, region);
}

}  // namespace

std::string RowField(const host::SessionState& state, std::string_view field) {
    const host::CatalogueState& catalogue = state.catalogue;
    if (!catalogue.CurrentRow) return {};
    const base::Region& region = state.region();
    data::Record& row = *catalogue.CurrentRow;
    if (base::EqualNoCase(field, "Price18")) {
        return tags::FixedPrice(row.GetField("Price"), tags::kTax18, region);
    }
    if (base::EqualNoCase(field, "Price")) {
        return tags::FormatFieldValue(row, "Price;fixed", "", region);
    }
    const bool final_price = base::StartsWithNoCase(field, "FinalPrice");
    if (!final_price && !base::StartsWithNoCase(field, "PriceCut")) {
        return tags::FormatFieldValue(row, field, "", region);
    }
    if (!catalogue.PriceRow) return {};
    data::Record& prices = *catalogue.PriceRow;
    if (base::EqualNoCase(field, "FinalPrice18")) return FinalPrice18(prices, region);
    return tags::FormatFieldValue(
        prices, final_price ? Fixed(field) : std::string(field), "", region);
}

std::string PriceField(const host::SessionState& state, std::string_view field) {
    if (!state.catalogue.PriceRow) return {};
    data::Record& prices = *state.catalogue.PriceRow;
    if (base::EqualNoCase(field, "FinalPrice18")) {
        return FinalPrice18(prices, state.region());
    }
    if (base::EqualNoCase(field, "FinalPriceWTax") && state.catalogue.CurrentRow) {
        return tags::FixedPrice(prices.GetField("FinalPrice"),
                                tags::TaxFactor(*state.catalogue.CurrentRow),
                                state.region());
    }
    return tags::FormatFieldValue(prices, field, "", state.region());
}

}  // namespace zebtell::catalogue
