#include "orders/header_fields.h"

#include "base/ignore_errors.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "orders/first_error.h"
#include "tags/custom_func.h"

namespace zebtell::orders {
namespace {

using host::SessionState;

constexpr std::string_view kPrefix = "SDOrder.";

// Calls `use` with the name behind "SDOrder." and the value of each such field that has one. What
// pages keep with an order ("@...") is not for forms to set.
template <class Use>
void ForEachHeaderField(const web::Request& request, Use&& use) {
    for (const web::Field& field : request.Form) {
        const std::string name = tags::CleanFormValue(field.name);
        if (!base::StartsWithNoCase(name, kPrefix)) continue;
        const std::string value = tags::CleanFormValue(field.value);
        const std::string_view header_field = std::string_view(name).substr(kPrefix.size());
        if (!value.empty() && !header_field.starts_with('@')) use(header_field, value);
    }
}

}  // namespace

void EnsureBasket(SessionState& state) {
    const data::BasketOwner owner{
        .IDPartner = state.company.CustomerKey,
        .IDGRCompContPerson = state.company.ContactLoaded ? state.company.IDContactPerson : 0};
    data::CreateBasket(state.basket, state.application(), owner);
    if (!state.basket.Basket) throw base::RuntimeError(base::errors::kObjectNotSet);
}

bool CreateBasketFromForm(SessionState& state, const web::Request& request) {
    if (state.basket.Basket) return true;
    EnsureBasket(state);
    SetHeaderFields(state, request);
    return true;
}

void SetHeaderFields(SessionState& state, const web::Request& request) {
    const auto settings = state.settings();
    FirstError refusal;
    ForEachHeaderField(request, [&](std::string_view name, const std::string& text) {
        base::Value value(text);
        const bool readable = !base::EndsWithNoCase(name, "date") || base::IgnoreErrors([&] {
            value = value.ToDateTime(settings->region());
        });
        if (readable) refusal.Try([&] { state.basket.Basket->SetField(name, value); });
    });
    refusal.Rethrow();
}

void ChangeHeaderFields(SessionState& state, const web::Request& request) {
    const auto settings = state.settings();
    ForEachHeaderField(request, [&](std::string_view name, const std::string& text) {
        const base::Value old = state.basket.Basket->GetField(name);
        const std::string old_text = old.IsBlank() ? "" : old.ToText(settings->region());
        if (!base::EqualNoCase(old_text, text)) state.basket.Basket->SetField(name, text);
    });
}

}  // namespace zebtell::orders
