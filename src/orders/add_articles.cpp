#include "orders/add_articles.h"

#include <unordered_map>

#include "host/errors.h"
#include "orders/header_fields.h"
#include "orders/permission.h"
#include "orders/wanted_articles.h"
#include "tags/declarations.h"
#include "tags/form_values.h"

namespace zebtell::orders {
namespace {

using host::SessionState;

// The basket's rows by article, for forms that keep one row an article.
using RowsByArticle = std::unordered_map<std::int64_t, std::shared_ptr<data::Record>>;

RowsByArticle ReadRows(const data::BasketValues& basket) {
    RowsByArticle rows;
    for (std::int64_t n = 1; n <= basket.BasketRows->Count(); ++n) {
        auto row = basket.BasketRows->Item(n);
        const base::Value article = row->GetField("IDGRArticle");
        if (article.IsBlank() || row->Status(data::kFixedRow)) continue;
        rows.emplace(article.ToInteger64(), std::move(row));
    }
    return rows;
}

void AddTo(data::BasketValues& basket, RowsByArticle& rows, const WantedArticle& wanted) {
    const auto known = rows.find(wanted.article);
    if (known != rows.end()) {
        const base::Value old = known->second->GetField("Quantity");
        const double sum = (old.IsBlank() ? 0 : old.ToDouble()) + wanted.quantity;
        ChangeQuantity(basket, *known->second, sum, wanted.asked);
        return;
    }
    AddBasketRow(basket, wanted.article, wanted.quantity, wanted.asked);
    rows.emplace(wanted.article, basket.BasketRows->Item(basket.BasketRows->Count()));
}

// The number of those that were added.
int AddAll(SessionState& state,
           const std::vector<WantedArticle>& all,
           bool one_row_an_article,
           Refusals& refusals) {
    if (all.empty()) return 0;
    EnsureBasket(state);
    RowsByArticle rows = ReadRows(state.basket);
    int added = 0;
    for (const WantedArticle& wanted : all) {
        const auto add = [&] {
            if (!one_row_an_article) rows.clear();
            AddTo(state.basket, rows, wanted);
            ++added;
        };
        host::Guarded(state, "Kaubainfo_Lisamine", add, [&] {
            refusals.Add(wanted.name, wanted.typed, wanted.box);
        });
    }
    return added;
}

}  // namespace

void Kaubainfo_Lisamine(SessionState& state, web::Call& call) {
    const auto work = [&] {
        tags::ReadCatalogueDeclarations(state, call);
        if (RefusesOrders(state, call)) return;
        Refusals refusals;
        const auto wanted = ReadWantedArticles(state, call.request, refusals);
        state.basket_form.LastForm.AddedRows =
            AddAll(state, wanted, tags::IsUniqueField(call.request, "ID"), refusals);
        refusals.Tell(state);
    };
    host::Guarded(
        state, "Kaubainfo_Lisamine", work, [&] { state.Message = "Viga rea lisamisel!"; });
    state.catalogue.ListFresh = true;
    call.NextItem("Kaubainfo");
}

}  // namespace zebtell::orders
