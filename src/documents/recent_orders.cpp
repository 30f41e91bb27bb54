#include "documents/recent_orders.h"

#include <algorithm>

#include "tags/field_text.h"
#include "tags/page_tags.h"

namespace zebtell::documents {
namespace {

using tags::TagCall;

constexpr std::int64_t kMostShown = 5;
constexpr std::string_view kSums[] = {"Amount", "TaxAmount", "AmountWTax"};

// Read anew each time: the last order may be a minute old, or have been delivered meanwhile.
bool RecentOrders(TagCall& c) {
    host::RecentOrders& recent = c.state.documents.Recent;
    recent = {};
    c.tag.Hide();
    if (!c.state.logon.Application) return true;
    recent.List = c.state.application().OpenList("SDOrder", "", "ID desc");
    tags::ShowIf(c, recent.List->Count() > 0);
    return true;
}

bool RecentOrder(TagCall& c) {
    host::RecentOrders& recent = c.state.documents.Recent;
    const std::int64_t last = recent.List ? std::min(recent.List->Count(), kMostShown) : 0;
    if (recent.Shown >= last) {
        c.tag.Hide();
        return true;
    }
    recent.Current = recent.List->Item(++recent.Shown);
    if (recent.Shown < last) {
        c.tag.Repeat("ZEB:RecentOrder");
    } else {
        c.tag.Show();
    }
    return true;
}

bool OrderField(TagCall& c) {
    tags::WriteField(c, c.state.documents.Recent.Current.get(), kSums);
    return true;
}

}  // namespace

void Raamistik_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(
        state, call, tag, "Raamistik_ProcessTag", "Raamistik", &RaamistikTagTable());
}

const tags::TagTable& RaamistikTagTable() {
    static const tags::TagTable kTable{
        {"ZEB:RecentOrders", RecentOrders, "contents when the customer has ordered before"},
        {"ZEB:RecentOrder", RecentOrder, "inside it: contents for each of the last five orders"},
        {"ZEB:SDOrder", OrderField, "inside that: a field of the order; sums with two decimals"},
    };
    return kTable;
}

}  // namespace zebtell::documents
