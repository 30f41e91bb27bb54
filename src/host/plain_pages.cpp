#include "host/plain_pages.h"

#include "host/errors.h"

namespace zebtell::host {

void Raamistik_Respond(SessionState& state, web::Call& call) {
    OrErrorPage(state, call, [&] { call.WriteTemplate(); });
}

void Vasak_Respond(SessionState& state, web::Call& call) {
    OrErrorPage(state, call, [&] { call.WriteTemplate(); });
}

void Vasak_Body1(SessionState&, web::Call& call) {
    call.NextItem("Kaubainfo");
}

void Yld_Respond(SessionState& state, web::Call& call) {
    OrErrorPage(state, call, [&] { call.WriteTemplate(); });
}

}  // namespace zebtell::host
