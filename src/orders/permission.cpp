#include "orders/permission.h"

#include "host/texts.h"
#include "tags/declarations.h"

namespace zebtell::orders {
namespace {

constexpr host::LocalText kRefused = {
    "Tellimine ei ole lubatud, palun pöörduge oma müügiesindaja poole!",
    "Ordering is not allowed, please contact your sales representative!",
    "Pasūtīt nav atļauts, lūdzu, sazinieties ar savu pārdošanas pārstāvi!"};

}  // namespace

bool RefusesOrders(host::SessionState& state, web::Call& call) {
    const auto& allowed = state.templates.OrdersAllowed;
    if (!allowed) tags::ReadDeclarations(state, call);
    if (allowed.value_or(true)) return false;
    state.Message = kRefused.In(state.settings()->language());
    return true;
}

}  // namespace zebtell::orders
