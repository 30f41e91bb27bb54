#include "orders/koostamine.h"

#include "base/ignore_errors.h"
#include "base/rounding.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "host/errors.h"
#include "orders/row_block.h"
#include "tags/basket_boxes.h"
#include "tags/field_text.h"
#include "tags/page_tags.h"

namespace zebtell::orders {
namespace {

using host::SessionState;
using tags::TagCall;

constexpr std::string_view kRowNumbers[] = {"amount", "quantity"};

bool TLKRida(TagCall& c) {
    return BasketRowBlock(c, "ZEB:TLKRida", c.state.basket.BasketRowCount);
}

bool OrderRow(TagCall& c) {
    const host::BasketFormState& form = c.state.basket_form;
    if (form.CurrentBasketRow && base::EqualNoCase(tags::Reference(c), "Kustuta")) {
        const int shown = form.BasketRowCursor - 1;
        c.tag.Write(c.call.URLFor("Koostamine", "DEL_" + std::to_string(shown)));
        return true;
    }
    tags::WriteField(c, form.CurrentBasketRow.get(), kRowNumbers);
    return true;
}

bool Order(TagCall& c) {
    data::Document* basket = c.state.basket.Basket.get();
    if (basket != nullptr && base::EqualNoCase(tags::Reference(c), "Explanation")) {
        tags::WritePlainField(c, *basket->Header(), "Explanation");
        return true;
    }
    tags::WriteField(c, basket == nullptr ? nullptr : basket->Header().get());
    return true;
}

// A row whose adding failed stands in the basket without a sum and a quantity, uncounted.
bool IsCounted(data::Record& row) {
    if (!row.GetField("@RowPrice").IsBlank()) return true;
    const base::Value quantity = row.GetField("Quantity");
    return !quantity.IsBlank() && quantity.ToDouble() != 0;
}

// What the totals hold of a row. The rows of a stored order have been counted by their sums.
base::Currency CountedSum(data::Record& row) {
    const base::Value sum = row.GetField("@RowPrice");
    return sum.IsBlank() ? row.GetField("Amount").ToCurrency() : sum.ToCurrency();
}

void DeleteRow(SessionState& state, std::string_view position) {
    data::BasketValues& basket = state.basket;
    if (!basket.BasketRows) throw base::RuntimeError(base::errors::kObjectNotSet);
    const auto row = basket.BasketRows->Item(base::Value(position).ToInteger16());
    if (row->Status(data::kFixedRow)) throw base::RuntimeError(base::errors::kInvalidCall);
    if (IsCounted(*row)) {
        basket.BasketRowCount = base::ToInteger16(basket.BasketRowCount - 1.0);
        base::IgnoreErrors([&] { basket.BasketQuantity -= row->GetField("Quantity").ToDouble(); });
        base::IgnoreErrors([&] { basket.BasketTotal -= CountedSum(*row); });
    }
    base::IgnoreErrors([&] { row->Delete(); });
}

bool Pressed(const web::Call& call, std::string_view button, std::string_view value) {
    return base::EqualNoCase(tags::CleanFormValue(call.request.Form[button]), value);
}

}  // namespace

void Koostamine_Respond(SessionState& state, web::Call& call) {
    state.basket_form.BasketRowCursor = 1;
    state.basket_form.CurrentBasketRow.reset();
    host::ShowPage(state, call);
    state.basket_form.LastForm = {};
}

void Koostamine_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(
        state, call, tag, "Koostamine_ProcessTag", "Koostamine", &KoostamineTagTable());
}

void Koostamine_UserEvent(SessionState& state, web::Call& call, std::string_view event) {
    host::Guarded(state, "Koostamine_UserEvent", [&] {
        if (base::StartsWithNoCase(event, "DEL_")) DeleteRow(state, event.substr(4));
    });
    const bool to_catalogue = base::EqualNoCase(call.request.Value("Next"), "Kaubainfo");
    if (to_catalogue) state.catalogue.ListFresh = true;  // at the page that was shown
    // By a redirect: the page loaded again must not take out one row more.
    call.RedirectTo(to_catalogue ? "Kaubainfo" : "Koostamine");
}

void Koostamine_Vormista(SessionState& state, web::Call& call) {
    const auto work = [&] {
        if (Pressed(call, "ZEB_But_LisaRidu", "Lisa ridu")) {
            call.RedirectTo("Kaubainfo");
        } else if (!state.basket.Basket) {
            call.RedirectTo("Koostamine");
        } else if (Pressed(call, "ZEB_But_Lisatellimus", "Vormista")) {
            call.RedirectTo("Kinnitus");
        } else {
            data::DiscardBasket(state.basket);
            call.RedirectTo("Koostamine");
        }
    };
    host::Guarded(state, "Koostamine_Vormista", work, [&] {
        state.Message = "Probleem andmete lugemisel, proovige uuesti!";
        call.RedirectTo("Koostamine");
    });
}

const tags::TagTable& KoostamineTagTable() {
    static const tags::TagTable kTable{
        {"ZEB:TLKRida", TLKRida, "contents once for each row of the basket"},
        {"ZEB:OrderRow", OrderRow, "a field of the row; Kustuta: address that takes it out"},
        {"ZEB:SDOrderRow", OrderRow, "the same as ZEB:OrderRow"},
        {"ZEB:Order", Order, "a field of the order"},
        {"ZEB:SDOrder", Order, "the same as ZEB:Order"},
        {"ZEB:MuudaKomment", tags::CommentBox, "name of the basket row's comment box"},
    };
    return kTable;
}

}  // namespace zebtell::orders
