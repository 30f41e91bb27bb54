#include "orders/lisamine.h"

#include "base/ignore_errors.h"
#include "base/rounding.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "host/errors.h"
#include "orders/basket_rows.h"
#include "orders/header_fields.h"
#include "orders/permission.h"
#include "tags/field_text.h"
#include "tags/fixed_tax.h"
#include "tags/page_tags.h"

namespace zebtell::orders {
namespace {

using host::SessionState;
using tags::TagCall;

constexpr std::string_view kFixed[] = {"Price"};

bool LisaRida(TagCall& c) {
    data::Record* row = c.state.basket_form.RowToAdd.get();
    const std::string field = tags::Reference(c);
    const bool with_own_tax = base::EqualNoCase(field, "PriceWTax");
    if (row == nullptr || (!with_own_tax && !base::EqualNoCase(field, "Price18"))) {
        tags::WriteField(c, row, kFixed);
        return true;
    }
    const auto settings = c.state.settings();
    c.tag.Write(tags::FixedPrice(row->GetField("Price"),
                                 with_own_tax ? tags::TaxFactor(*row) : tags::kTax18,
                                 settings->region()));
    return true;
}

double TypedQuantity(const web::Call& call) {
    const std::string typed = tags::CleanFormValue(call.request.Form["ZEBInQuant"]);
    const double quantity = base::Value(base::Replaced(typed, " ", "")).ToDouble();
    const bool is_fit = quantity > 0 && quantity <= kMostQuantity;
    if (typed.empty() || !is_fit) throw base::RuntimeError(base::errors::kTypeMismatch);
    return quantity;
}

void AddRow(SessionState& state, const web::Call& call) {
    EnsureBasket(state);
    data::BasketValues& basket = state.basket;
    const auto row = basket.BasketRows->AddRow();
    state.basket_form.AddedRow = row;
    row->SetField("IDGRArticle", tags::CleanFormValue(call.request.Form["IDGRArticle"]));
    const double quantity = TypedQuantity(call);
    row->SetField("Quantity", quantity);
    const auto sum = base::Multiplied(row->GetField("Price").ToCurrency(), quantity, 2);
    row->SetField("@RowPrice", sum);
    row->Update(0);
    basket.BasketRowCount = base::ToInteger16(basket.BasketRowCount + 1.0);
    base::IgnoreErrors([&] { basket.BasketQuantity += quantity; });
    base::IgnoreErrors([&] { basket.BasketTotal += sum; });
}

}  // namespace

void Lisamine_Respond(SessionState& state, web::Call& call) {
    host::ShowPage(state, call);
}

void Lisamine_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(
        state, call, tag, "Lisamine_ProcessTag", "GRPriceListRel", &LisamineTagTable());
}

void Lisamine_UserEvent(SessionState& state, web::Call& call, std::string_view event) {
    host::Guarded(state, "Lisamine_UserEvent", [&] {
        if (!base::StartsWithNoCase(event, "ID_")) return;
        state.basket_form.RowToAdd.reset();
        const auto& list = state.catalogue.ListQuery;
        if (!list) throw base::RuntimeError(base::errors::kObjectNotSet);
        state.basket_form.RowToAdd = list->Find("ID=" + std::string(event.substr(3)));
    });
    call.NextItem("Lisamine");
}

void Lisamine_Lisamine(SessionState& state, web::Call& call) {
    const auto work = [&] {
        if (RefusesOrders(state, call)) return call.RedirectTo("Lisamine");
        AddRow(state, call);
        call.RedirectTo("Lisatud");
    };
    host::Guarded(state, "Lisamine_Lisamine", work, [&] {
        state.Message = "Viga rea lisamisel!";
        call.RedirectTo("Lisamine");
    });
}

void Lisatud_Respond(SessionState& state, web::Call& call) {
    host::OrErrorPage(state, call, [&] { call.WriteTemplate(); });
}

const tags::TagTable& LisamineTagTable() {
    static const tags::TagTable kTable{
        {"ZEB:LisaRida", LisaRida, "a field or price of the article to add"},
    };
    return kTable;
}

}  // namespace zebtell::orders
