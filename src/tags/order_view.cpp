#include "tags/order_view.h"

#include <utility>

#include "base/rounding.h"
#include "tags/field_text.h"

namespace zebtell::tags {
namespace {

using data::ShownDocument;

constexpr std::string_view kHeaderSums[] = {"Amount", "TaxAmount", "AmountWTax"};
constexpr std::string_view kRowNumbers[] = {"Amount", "Quantity", "UnitPrice", "Price"};
constexpr std::string_view kTaxSums[] = {"Base", "Amount"};

ShownDocument& Shown(TagCall& c) {
    return c.state.documents.ShownOrder;
}

// One line of a block: reads the record under the cursor and comes again while there are more.
bool Line(TagCall& c,
          std::string_view tag,
          data::RecordList* list,
          std::int16_t count,
          std::int16_t& cursor,
          std::shared_ptr<data::Record>& current) {
    if (list == nullptr || cursor > count) {
        c.tag.Hide();
        return true;
    }
    current = list->Item(cursor);
    if (cursor < count) {
        c.tag.Repeat(tag);
    } else {
        c.tag.Show();
    }
    cursor = base::ToInteger16(cursor + 1.0);
    return true;
}

bool TellRida(TagCall& c) {
    ShownDocument& order = Shown(c);
    return Line(
        c, "ZEB:TellRida", order.Rows.get(), order.RowCount, order.RowCursor, order.CurrentRow);
}

bool MaksuRida(TagCall& c) {
    ShownDocument& order = Shown(c);
    return Line(
        c, "ZEB:MaksuRida", order.Taxes.get(), order.TaxCount, order.TaxCursor, order.CurrentTax);
}

bool Header(TagCall& c) {
    WriteField(c, Shown(c).Header.get(), kHeaderSums);
    return true;
}

bool RowField(TagCall& c) {
    WriteField(c, Shown(c).CurrentRow.get(), kRowNumbers);
    return true;
}

bool TaxField(TagCall& c) {
    WriteField(c, Shown(c).CurrentTax.get(), kTaxSums);
    return true;
}

bool JustSaved(TagCall& c) {
    ShowIf(c, std::exchange(c.state.confirmation.OrderJustSaved, false));
    return true;
}

bool OrderExists(TagCall& c) {
    ShowIf(c, Shown(c).Header != nullptr);
    return true;
}

bool OrderNotExists(TagCall& c) {
    ShowIf(c, Shown(c).Header == nullptr);
    return true;
}

// Staff have not begun to process the order: its customer may still change it.
bool OrderOpen(TagCall& c) {
    c.tag.Hide();  // also when the state can't be read
    data::Record* header = Shown(c).Header.get();
    ShowIf(c, header != nullptr && header->GetField("State").ToInteger64() == 0);
    return true;
}

bool OrderLink(TagCall& c) {
    c.tag.Hide();
    if (data::Record* header = Shown(c).Header.get()) {
        c.tag.Write(c.call.URLFor("Tellimus", "ID_" + header->GetField("ID").ToPlainText()));
    }
    return true;
}

}  // namespace

const TagTable& OrderViewTagTable() {
    static const TagTable kTable{
        {"ZEB:SDOrder", Header, "a field of the order; sums with two decimals"},
        {"ZEB:SDOrder.Exists", OrderExists, "contents when there is an order to show"},
        {"ZEB:SDOrder.NotExists", OrderNotExists, "contents when there is none"},
        {"ZEB:SDOrder.Open", OrderOpen, "contents while the customer may still change the order"},
        {"ZEB:TellRida", TellRida, "contents once for each row"},
        {"ZEB:SDOrderRow", RowField, "a field of the row; prices and sums with two decimals"},
        {"ZEB:MaksuRida", MaksuRida, "contents once for each tax line"},
        {"ZEB:GDTax", TaxField, "a field of the tax line"},
        {"ZEB:JustSaved", JustSaved, "contents once, right after the order was stored"},
        {"ZEB:SDOrderLink", OrderLink, "address of the order's own page"},
    };
    return kTable;
}

void ReadShownOrder(host::SessionState& state) {
    const std::string& filter = state.confirmation.ShownOrderFilter;
    if (state.documents.ShownOrder.Header || filter.empty()) return;
    data::LoadShownOrder(state.application(), filter, state.documents.ShownOrder);
}

void RewindOrderView(host::SessionState& state) {
    ShownDocument& order = state.documents.ShownOrder;
    order.RowCursor = 1;
    order.TaxCursor = 1;
    order.CurrentRow.reset();
    order.CurrentTax.reset();
}

}  // namespace zebtell::tags
