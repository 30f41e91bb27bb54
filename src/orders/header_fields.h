#pragma once

#include "host/session_state.h"

namespace zebtell::orders {

// Makes a basket for the logged-on customer unless there is one. RuntimeError 91 when that failed.
void EnsureBasket(host::SessionState& state);

// Makes a basket with the header fields that the form has; an existing basket stays as it is.
// Always true.
bool CreateBasketFromForm(host::SessionState& state, const web::Request& request);

// Sets every posted "SDOrder." field that is not empty. Names that end in "date" take dates; a
// field whose date can't be read is skipped. A field that is refused does not keep back the
// others: the first refusal is thrown when all are done.
void SetHeaderFields(host::SessionState& state, const web::Request& request);

// Sets the posted "SDOrder." fields that differ from the header's, as text.
void ChangeHeaderFields(host::SessionState& state, const web::Request& request);

}  // namespace zebtell::orders
