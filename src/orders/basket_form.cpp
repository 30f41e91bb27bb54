#include "orders/basket_form.h"

#include "base/ignore_errors.h"
#include "base/text.h"
#include "host/errors.h"
#include "orders/basket_rows.h"
#include "orders/header_fields.h"
#include "orders/refusals.h"
#include "tags/custom_func.h"
#include "tags/declarations.h"
#include "tags/form_values.h"

namespace zebtell::orders {
namespace {

using base::Currency;
using data::Record;
using host::SessionState;

std::string Posted(const web::Call& call, std::string_view name) {
    return tags::CleanFormValue(call.request.Form[name]);
}

Currency PostedPrice(const web::Call& call, std::string_view prefix, const std::string& row_id) {
    const auto number = base::ParseNumber(Posted(call, std::string(prefix) + row_id));
    return number ? Currency::FromDouble(*number) : Currency();
}

void ChangeRowQuantity(
    SessionState& state, const web::Call& call, Record& row, std::int64_t n, Refusals& refusals) {
    const std::string box = "Row_" + std::to_string(n);
    // Another tab may have added this row since the form was written: it keeps its quantity.
    if (!call.request.Form.Has(box)) return;
    std::string typed = Posted(call, box);
    if (typed.empty()) typed = "0";
    double quantity = 0;
    if (!tags::ParseQuantity(state, typed, quantity) || quantity < 0 || quantity > kMostQuantity) {
        const base::Value code = row.GetField("GRArticle.Code");
        refusals.Add(code.IsBlank() ? "" : code.ToPlainText(), typed, box);
        return;
    }
    const std::string id = row.GetField("ID").ToPlainText();
    ChangeQuantity(state.basket,
                   row,
                   quantity,
                   {PostedPrice(call, "Price_", id), PostedPrice(call, "UPrice_", id)});
}

bool Differs(Record& row,
             std::string_view field,
             const std::string& typed,
             const base::Region& region) {
    const base::Value value = row.GetField(field);
    return !base::EqualNoCase(value.IsBlank() ? "" : value.ToText(region), typed);
}

bool ChangeExtraField(Record& row,
                      const std::string& field,
                      const std::string& typed,
                      const base::Region& region) {
    if (!Differs(row, field, typed, region)) return false;
    base::Value value(typed);
    if (base::EndsWithNoCase(field, "date") &&
        !base::IgnoreErrors([&] { value = value.ToDateTime(region); })) {
        return false;
    }
    row.SetField(field, value);
    return true;
}

// Comment and further fields of a row; a field that can't be written is left as it was. A field
// that the form does not have is not a wish to empty it.
void ChangeRowTexts(SessionState& state, const web::Call& call, Record& row, std::int64_t n) {
    const auto settings = state.settings();
    const std::string number = std::to_string(n);
    bool changed = false;
    for (const std::string& field : state.basket_form.EditableRowFields) {
        std::string box = "EF_";
        box.append(field).append("_").append(number);
        if (!call.request.Form.Has(box)) continue;
        base::IgnoreErrors([&] {
            changed |= ChangeExtraField(row, field, Posted(call, box), settings->region());
        });
    }
    const std::string box = "Expl_" + number;
    if (state.basket_form.ShowRowExplanations && call.request.Form.Has(box)) {
        base::IgnoreErrors([&] {
            const std::string typed = Posted(call, box);
            if (!Differs(row, "Explanation", typed, settings->region())) return;
            row.SetField("Explanation", typed);
            changed = true;
        });
    }
    if (changed) row.Update(0);
}

// Calls `change` for every row of the basket that the form may touch, with its number.
template <class Change>
void ForEachFormRow(SessionState& state, Change&& change) {
    const auto rows = state.basket.BasketRows;
    for (std::int64_t n = 1; n <= rows->Count(); ++n) {
        const auto row = rows->Item(n);
        if (!row->Status(data::kFixedRow)) change(*row, n);
    }
}

void ChangeBasket(SessionState& state, const web::Call& call) {
    if (!state.basket.Basket) return;
    ChangeHeaderFields(state, call.request);
    Refusals refusals;
    ForEachFormRow(state, [&](Record& row, std::int64_t n) {
        ChangeRowQuantity(state, call, row, n, refusals);
        ChangeRowTexts(state, call, row, n);
    });
    refusals.Tell(state);
}

// The basket's form may stand on the page of the basket, too.
std::string_view PageOfForm(const web::Call& call) {
    const bool own_page = base::EqualNoCase(call.request.Value("Next"), "Koostamine");
    return own_page ? "Koostamine" : "Kaubainfo";
}

// Each button is looked at, also when one before it was pressed: the last one decides the page.
void PressButtons(SessionState& state, web::Call& call) {
    if (!Posted(call, "Vormista").empty()) {
        state.basket_form.ReturnPage = "Kaubainfo";
        call.NextItem("Kinnitus");
        if (!Posted(call, "Vormista_Muuda").empty()) ChangeBasket(state, call);
    }
    if (!Posted(call, "Order_Clear").empty()) {
        data::DiscardBasket(state.basket);
        call.NextItem(PageOfForm(call));
    }
    if (!Posted(call, "Change_Quant").empty()) {
        call.NextItem(PageOfForm(call));
        ChangeBasket(state, call);
    }
}

// What all events of the basket form have in common: the price list stays on its page, and an
// error shows the catalogue.
template <class Work>
void OnCatalogue(SessionState& state, web::Call& call, std::string_view handler, Work&& work) {
    state.catalogue.ListFresh = true;
    host::Guarded(state, handler, work, [&] { call.NextItem(PageOfForm(call)); });
}

}  // namespace

void Kaubainfo_Tellimus(SessionState& state, web::Call& call) {
    OnCatalogue(state, call, "Kaubainfo_Tellimus", [&] {
        tags::ReadCatalogueDeclarations(state, call);
        PressButtons(state, call);
    });
}

void Kaubainfo_MuudaRead(SessionState& state, web::Call& call) {
    OnCatalogue(state, call, "Kaubainfo_MuudaRead", [&] {
        call.NextItem("Kaubainfo");
        if (!state.basket.Basket) return;
        ForEachFormRow(state,
                       [&](Record& row, std::int64_t n) { ChangeRowTexts(state, call, row, n); });
    });
}

void Kaubainfo_UusTellimus(SessionState& state, web::Call& call) {
    OnCatalogue(state, call, "Kaubainfo_UusTellimus", [&] {
        call.NextItem("Kaubainfo");
        CreateBasketFromForm(state, call.request);
    });
}

}  // namespace zebtell::orders
