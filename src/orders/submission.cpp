#include "base/ignore_errors.h"
#include "base/text.h"
#include "host/errors.h"
#include "host/texts.h"
#include "orders/first_error.h"
#include "orders/header_fields.h"
#include "orders/kinnitus.h"
#include "orders/permission.h"
#include "orders/saving_problem.h"
#include "tags/custom_func.h"
#include "tags/order_view.h"

namespace zebtell::orders {
namespace {

using host::SessionState;

constexpr host::LocalText kStoredBefore = {"Tellimus on salvestatud nii, nagu siin näha.",
                                           "The order is stored as shown here.",
                                           "Pasūtījums ir saglabāts tā, kā šeit redzams."};
constexpr host::LocalText kNoBasket = {
    "Tellimust ei salvestatud: seda korvi enam ei ole, palun koostage tellimus uuesti.",
    "The order was not stored: this basket is gone, please make the order again.",
    "Pasūtījums nav saglabāts: šī groza vairs nav, lūdzu, izveidojiet pasūtījumu no jauna."};
constexpr host::LocalText kOtherBasket = {
    "Tellimust ei salvestatud: korvis on nüüd teine tellimus, palun vaadake see üle.",
    "The order was not stored: the basket holds another order now, please look it over.",
    "Pasūtījums nav saglabāts: grozā tagad ir cits pasūtījums, lūdzu, pārbaudiet to."};

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
        FirstError refusal;
        refusal.Try([&] { SetHeaderFields(state, call.request); });
        const std::string comment = Posted(call, "ZEB_Komment");
        const base::Value old = basket->GetField("Explanation");
        if (!base::EqualNoCase(old.IsBlank() ? "" : old.ToPlainText(), comment)) {
            refusal.Try([&] { basket->SetField("Explanation", comment); });
        }
        refusal.Rethrow();
    }
    call.RedirectTo("Kaubainfo");
}

// Whatever can be taken is taken, so that a form shown again holds what was typed.
void FillHeader(SessionState& state, const web::Call& call) {
    FirstError refusal;
    const auto set = [&](std::string_view field, const base::Value& value) {
        refusal.Try([&] { state.basket.Basket->SetField(field, value); });
    };
    refusal.Try([&] { SetHeaderFields(state, call.request); });
    const std::string name = Posted(call, "ZEB_Nimi");
    if (!name.empty()) set("CompanyName", name);
    const std::string address = Posted(call, "ZEB_Aadress");
    if (!address.empty()) set("CompanyAddr", address);
    set("Explanation", Posted(call, "ZEB_Komment"));
    if (state.company.ContactLoaded) set("IDGRCompContPerson", state.company.IDContactPerson);
    refusal.Rethrow();
}

bool PressedStore(const web::Call& call) {
    return Pressed(call, "ZEB_But_Vormista") || Pressed(call, "ZEB_But_Vormista2");
}

// Leads to a stored order. When it was not this request that stored it, the page says so, unless
// the thanks for it have not been seen yet.
void ShowStored(SessionState& state, web::Call& call, const std::string& id, data::Saved saved) {
    host::ConfirmationState& confirmation = state.confirmation;
    const std::string filter = "ID_" + id;
    const bool is_thanked_for =
        confirmation.OrderJustSaved && confirmation.ShownOrderFilter == filter;
    confirmation.OrderJustSaved = saved == data::Saved::kNow || is_thanked_for;
    if (!confirmation.OrderJustSaved) {
        state.Message = kStoredBefore.In(state.settings()->language());
    }
    confirmation.ShownOrderFilter = filter;
    // The order stands, whether it can be read at once or not: the page that shows it reads it
    // then.
    state.documents.ShownOrder = {};
    host::Guarded(state, "Kinnitus_LisaTellimus", [&] { tags::ReadShownOrder(state); });
    call.RedirectTo(Pressed(call, "ZEB_But_Vormista") ? "Tellimus" : "Kinnitatud");
}

void Store(SessionState& state, web::Call& call) {
    if (RefusesOrders(state, call)) return call.RedirectTo("Kinnitus");
    FillHeader(state, call);
    const data::Saved saved = state.basket.Basket->Save();
    const std::string id = state.basket.Basket->GetField("ID").ToPlainText();
    data::DiscardBasket(state.basket);
    ShowStored(state, call, id, saved);
}

// Whether the form was written for the basket that there is now. Forms without a key are believed.
bool IsOfThisBasket(const SessionState& state, const web::Call& call) {
    const std::string key = Posted(call, "ZEB_DocKey");
    const data::Document* basket = state.basket.Basket.get();
    return key.empty() || (basket != nullptr && basket->Key() == key);
}

// The form of a basket that was stored, dropped, or lost with its session. Nothing of it may get
// into the basket that there is now.
void AnswerLateForm(SessionState& state, web::Call& call) {
    if (Pressed(call, "ZEB_But_Tagasi")) return call.RedirectTo("Kaubainfo");
    const auto orders = state.application().OpenTable("SDOrder");
    if (const std::int64_t id = orders->FindKey(Posted(call, "ZEB_DocKey"))) {
        return ShowStored(state, call, std::to_string(id), data::Saved::kBefore);
    }
    const bool has_basket = state.basket.Basket != nullptr;
    if (PressedStore(call)) {
        const host::LocalText& text = has_basket ? kOtherBasket : kNoBasket;
        state.Message = text.In(state.settings()->language());
    }
    call.RedirectTo(has_basket ? "Kinnitus" : "Kaubainfo");
}

// The ID of the order that the basket has become although saving it seemed to fail, since the
// database's answer was lost; 0: none.
std::int64_t StoredUnnoticed(SessionState& state) {
    data::Document& basket = *state.basket.Basket;
    const bool is_change_of_order = basket.GetField("ID").ToInteger64() != 0;
    return is_change_of_order ? 0 : state.application().OpenTable("SDOrder")->FindKey(basket.Key());
}

void Drop(SessionState& state, web::Call& call) {
    const std::int64_t stored = StoredUnnoticed(state);
    data::DiscardBasket(state.basket);
    if (stored != 0) return ShowStored(state, call, std::to_string(stored), data::Saved::kBefore);
    base::IgnoreErrors([&] {
        if (base::EqualNoCase(Posted(call, "ZEB_Kustuta_Go"), "FirmaInfo")) {
            call.RedirectTo("Firmainfo");
        } else if (ReturnsToCatalogue(state)) {
            call.RedirectTo("Kaubainfo");
        }
    });
}

void PressButton(SessionState& state, web::Call& call) {
    if (!IsOfThisBasket(state, call)) {
        AnswerLateForm(state, call);
    } else if (Pressed(call, "ZEB_But_Tagasi")) {
        GoBack(state, call);
    } else if (!state.basket.Basket) {
        // A second click behind the one that stored the order is led to the order.
        call.RedirectTo(state.confirmation.OrderJustSaved ? "Tellimus" : "Kaubainfo");
    } else if (PressedStore(call)) {
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
    SavingProblem problem;
    const auto work = [&] {
        try {
            PressButton(state, call);
        } catch (const std::exception& error) {
            problem = DescribeSavingProblem(error, state.settings()->language());
            throw;
        }
    };
    host::Guarded(state, "Kinnitus_LisaTellimus", work, [&] {
        state.Message = problem.message;
        const std::string field(problem.field);
        if (!field.empty()) state.basket_form.LastForm.Refused[field] = Posted(call, field);
        call.RedirectTo("Kinnitus");
    });
}

}  // namespace zebtell::orders
