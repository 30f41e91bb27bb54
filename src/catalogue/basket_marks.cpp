#include "catalogue/basket_marks.h"

namespace zebtell::catalogue {
namespace {

using Quantities = std::unordered_map<std::int64_t, double>;

Quantities CountBasket(data::RecordList& rows) {
    Quantities quantities;
    for (std::int64_t n = 1; n <= rows.Count(); ++n) {
        const auto row = rows.Item(n);
        const base::Value article = row->GetField("IDGRArticle");
        const base::Value quantity = row->GetField("Quantity");
        if (article.IsBlank() || quantity.IsBlank()) continue;
        quantities[article.ToInteger64()] += quantity.ToDouble();
    }
    return quantities;
}

}  // namespace

double QuantityInBasket(host::SessionState& state) {
    host::CatalogueState& catalogue = state.catalogue;
    if (!state.basket.BasketRows || !catalogue.CurrentRow) return 0;
    auto& quantities = catalogue.BasketQuantities;
    if (!quantities) quantities = CountBasket(*state.basket.BasketRows);
    const auto found =
        quantities->find(catalogue.CurrentRow->GetField("IDGRArticle").ToInteger64());
    return found == quantities->end() ? 0 : found->second;
}

}  // namespace zebtell::catalogue
