#pragma once

#include <string>

#include "host/session_state.h"

namespace zebtell::tags {

// Has the page's template written for what its tags declare; nothing of it is sent, and a message
// waits for the page that is.
inline void ReadDeclarations(host::SessionState& state, web::Call& call) {
    const std::string message = state.Message;
    call.WriteTemplate();
    call.response.Clear();
    state.Message = message;
}

// The same for an event of the catalogue, when the session has not seen that page yet: its
// template declares page length, favourites, search columns and the decimals of quantities.
inline void ReadCatalogueDeclarations(host::SessionState& state, web::Call& call) {
    const host::CatalogueState& catalogue = state.catalogue;
    const bool seen =
        catalogue.ListQuery || catalogue.PageLength != 0 || !catalogue.FavoritesText.empty();
    if (!seen) ReadDeclarations(state, call);
}

}  // namespace zebtell::tags
