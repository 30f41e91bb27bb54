#include "tags/row_loop.h"

#include "base/ignore_errors.h"
#include "base/rounding.h"

namespace zebtell::tags {

namespace {

constexpr std::string_view kNextTag = "ZEB:Tellimus.Read.Next";

bool IsShown(data::RecordList& rows, std::int64_t index) {
    bool fixed = false;
    base::IgnoreErrors([&] { fixed = rows.Item(index)->Status(data::kFixedRow); });
    return !fixed;
}

// The number of the last row to show, 0 without any. Rows after it, such as transport at the end
// of an order, must not leave an empty line on the page.
std::int64_t LastShown(data::RecordList& rows) {
    std::int64_t last = rows.Count();
    while (last > 0 && !IsShown(rows, last)) --last;
    return last;
}

// Shows the row `index`, or the first after it that is shown, and goes on with the tag for the next
// if there are more.
void ShowFrom(TagCall& call, std::int64_t index) {
    call.tag.Hide();
    std::int16_t& shown = call.state.basket_form.RowIndex;
    shown = base::ToInteger16(static_cast<double>(index));
    if (!call.state.basket.Basket) return;
    data::RecordList& rows = *call.state.basket.BasketRows;
    const std::int64_t last = LastShown(rows);
    while (index < last && !IsShown(rows, index)) ++index;
    shown = base::ToInteger16(static_cast<double>(index));
    if (index < last) {
        call.tag.Repeat(kNextTag);
    } else if (index == last) {
        call.tag.Show();
    }
}

}  // namespace

void ReadRows(TagCall& call) {
    ShowFrom(call, 1);
}

void ReadNextRow(TagCall& call) {
    ShowFrom(call, std::int64_t{call.state.basket_form.RowIndex} + 1);
}

}  // namespace zebtell::tags
