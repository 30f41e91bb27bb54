#include "base/ignore_errors.h"
#include "base/text.h"
#include "host/errors.h"
#include "orders/header_fields.h"
#include "orders/kinnitus.h"
#include "tags/custom_func.h"
#include "tags/order_view.h"

namespace zebtell::orders {
namespace {

using host::SessionState;

std::string Posted(const web::Call& call, std::string_view field) {
    return tags::CleanFormValue(call.request.Form[field]);
}

bool Pressed(const web::Call& call, std::string_view button) {
    return !Posted(call, button).empty();
}

bool ReturnsToCatalogue(const SessionState& state) {
    const std::string& page = state.basket_form.ReturnPage;
    return page.empty() || base::EqualNoCase(page, "Kaubainfo");
}

// Back to the catalogue; what was typed stays with the basket.
void GoBack(SessionState& state, web::Call& call) {
    if (data::Document* basket = state.basket.Basket.get()) {
        SetHeaderFields(state, call.request);
        const std::string comment = Posted(call, "ZEB_Komment");
        const base::Value old = basket->GetField("Explanation");
        if (!base::EqualNoCase(old.IsBlank() ? "" : old.ToPlainText(), comment)) {
            basket->SetField("Explanation", comment);
        }
    }
    call.RedirectTo("Kaubainfo");
}

void FillHeader(SessionState& state, const web::Call& call) {
    data::Document& basket = *state.basket.Basket;
    SetHeaderFields(state, call.request);
    const std::string name = Posted(call, "ZEB_Nimi");
    if (!name.empty()) basket.SetField("CompanyName", name);
    const std::string address = Posted(call, "ZEB_Aadress");
    if (!address.empty()) basket.SetField("CompanyAddr", address);
    basket.SetField("Explanation", Posted(call, "ZEB_Komment"));
    if (state.company.ContactLoaded) {
        basket.SetField("IDGRCompContPerson", state.company.IDContactPerson);
    }
}

void Store(SessionState& state, web::Call& call) {
    FillHeader(state, call);
    state.basket.Basket->Save();
    state.confirmation.ShownOrderFilter = "ID_" + state.basket.Basket->GetField("ID").ToPlainText();
    data::DiscardBasket(state.basket);
    state.confirmation.OrderJustSaved = true;
    data::LoadShownOrder(
        state.application(), state.confirmation.ShownOrderFilter, state.documents.ShownOrder);
    call.RedirectTo(Pressed(call, "ZEB_But_Vormista") ? "Tellimus" : "Kinnitatud");
}

void Drop(SessionState& state, web::Call& call) {
    data::DiscardBasket(state.basket);
    base::IgnoreErrors([&] {
        if (base::EqualNoCase(Posted(call, "ZEB_Kustuta_Go"), "FirmaInfo")) {
            call.RedirectTo("Firmainfo");
        } else if (ReturnsToCatalogue(state)) {
            call.RedirectTo("Kaubainfo");
        }
    });
}

void PressButton(SessionState& state, web::Call& call) {
    if (Pressed(call, "ZEB_But_Tagasi")) {
        GoBack(state, call);
    } else if (!state.basket.Basket) {
        // A second click behind the one that stored the order is led to the order.
        call.RedirectTo(state.confirmation.OrderJustSaved ? "Tellimus" : "Kaubainfo");
    } else if (Pressed(call, "ZEB_But_Vormista") || Pressed(call, "ZEB_But_Vormista2")) {
        Store(state, call);
    } else if (Pressed(call, "ZEB_But_Kustuta")) {
        Drop(state, call);
    } else {
        // A form without a known button drops the order.
        data::DiscardBasket(state.basket);
        if (ReturnsToCatalogue(state)) call.RedirectTo("Kaubainfo");
    }
}

}  // namespace

void Kinnitus_LisaTellimus(SessionState& state, web::Call& call) {
    if (!host::CheckLogon(state, call)) return;
    const auto failed = [&] {
        state.Message = "Probleem tellimuse salvestamisel!";
        call.RedirectTo("Kinnitus");
    };
    host::Guarded(
        state, "Kinnitus_LisaTellimus", [&] { PressButton(state, call); }, failed);
}

}  // namespace zebtell::orders
