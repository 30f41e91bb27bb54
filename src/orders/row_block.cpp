#include "orders/row_block.h"

#include "base/rounding.h"

namespace zebtell::orders {

bool BasketRowBlock(tags::TagCall& call, std::string_view tag, std::int64_t last) {
    const data::BasketValues& basket = call.state.basket;
    host::BasketFormState& form = call.state.basket_form;
    if (!basket.BasketRows || basket.BasketRows->Count() == 0) {
        call.tag.Hide();
        return true;
    }
    form.CurrentBasketRow = basket.BasketRows->Item(form.BasketRowCursor);
    const bool hidden = form.CurrentBasketRow->Status(data::kFixedRow);
    const bool is_last = form.BasketRowCursor >= last;
    if (is_last) {
        hidden ? call.tag.Hide() : call.tag.Show();
    } else {
        hidden ? call.tag.Continue(tag) : call.tag.Repeat(tag);
    }
    form.BasketRowCursor = base::ToInteger16(form.BasketRowCursor + 1.0);
    return true;
}

}  // namespace zebtell::orders
