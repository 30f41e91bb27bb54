#include "account/kasutaja.h"

#include "host/errors.h"
#include "tags/page_tags.h"

namespace zebtell::account {

void Kasutaja_Respond(host::SessionState& state, web::Call& call) {
    host::OrErrorPage(state, call, [&] { call.WriteTemplate(); });
}

void Kasutaja_ProcessTag(host::SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(state, call, tag, "Kasutaja_ProcessTag", "Kasutaja", nullptr);
}

}  // namespace zebtell::account
