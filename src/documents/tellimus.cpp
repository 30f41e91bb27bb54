#include "documents/tellimus.h"

#include "base/text.h"
#include "host/errors.h"
#include "tags/order_view.h"
#include "tags/page_tags.h"

namespace zebtell::documents {
namespace {

using host::SessionState;

void ShowOrder(SessionState& state, web::Call& call) {
    tags::RewindOrderView(state);
    host::ShowPage(state, call);
}

}  // namespace

void Tellimus_Respond(SessionState& state, web::Call& call) {
    host::Guarded(state, "Tellimus_Respond", [&] { tags::ReadShownOrder(state); });
    ShowOrder(state, call);
}

void Tellimus_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(
        state, call, tag, "Tellimus_ProcessTag", "Tellimus", &tags::OrderViewTagTable());
}

void Tellimus_UserEvent(SessionState& state, web::Call& call, std::string_view event) {
    const auto load = [&] {
        if (!base::StartsWithNoCase(event, "ID_")) return;
        state.documents.ShownOrder = {};
        state.confirmation.ShownOrderFilter = event;
        tags::ReadShownOrder(state);
    };
    // An order of somebody else and a number that there is not get the same answer.
    const auto show_none = [&] {
        state.confirmation.ShownOrderFilter.clear();
        state.Message = "Probleem andmete lugemisel, proovige uuesti!";
    };
    host::Guarded(state, "Tellimus_UserEvent", load, show_none);
    ShowOrder(state, call);
}

}  // namespace zebtell::documents
