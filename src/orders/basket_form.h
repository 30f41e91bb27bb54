#pragma once

#include "host/session_state.h"

namespace zebtell::orders {

// The basket form beside the price list: clear, change, or go on to the confirmation. A form with
// the field "Vormista_Muuda" has its changes applied before it goes on.
void Kaubainfo_Tellimus(host::SessionState& state, web::Call& call);

// Only the comments and further fields of the basket's rows.
void Kaubainfo_MuudaRead(host::SessionState& state, web::Call& call);

// Begins an order with the header fields of the form.
void Kaubainfo_UusTellimus(host::SessionState& state, web::Call& call);

}  // namespace zebtell::orders
