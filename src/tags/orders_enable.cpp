#include "tags/orders_enable.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "tags/field_text.h"
#include "tags/form_values.h"

namespace zebtell::tags {

namespace {

base::Value PartnerField(const TagCall& call, std::string_view field) {
    const auto& partner = call.state.company.PartnerRecord;
    if (!partner) throw base::RuntimeError(base::errors::kObjectNotSet);
    return partner->GetField("Partner." + std::string(field));
}

bool ByQuery(TagCall& call, std::string_view name, std::string_view field) {
    data::clsQuery& query = GetQuery(call.state, name, call.page);
    const auto records = query.Records(PartnerField(call, "ID"));
    return records->Item(query.RecNo)->GetField(field).ToBoolean();
}

}  // namespace

void EnableOrders(TagCall& call) {
    call.tag.Hide();
    const std::string reference = Reference(call);
    const auto parts = base::Split(reference, '.');
    auto& allowed = call.state.templates.OrdersAllowed;
    if (parts.size() == 1) {
        allowed = PartnerField(call, parts[0]).ToBoolean();
    } else if (parts.size() > 1 && QueryExists(call.state, parts[0], call.page)) {
        allowed = ByQuery(call, parts[0], parts[1]);
    }
}

}  // namespace zebtell::tags
