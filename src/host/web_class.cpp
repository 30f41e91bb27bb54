#include "host/web_class.h"

#include "base/ignore_errors.h"
#include "base/text.h"
#include "data/price_query_text.h"
#include "host/error_text.h"

namespace zebtell::host {
namespace {

// From the first day of this month to today.
DateRange ThisMonth(base::DateTime today) {
    return {base::DateTime(today.days() - today.Calendar().day + 1), today};
}

web::Standing StandingOf(const SessionState& state) {
    if (!state.logon.LoggedOn) return web::Standing::kAnonymous;
    return state.logon.IsGuest ? web::Standing::kGuest : web::Standing::kUser;
}

}  // namespace

void WebClass_Initialize(SessionState& state) {
    base::IgnoreErrors([&] {
        const DateRange range = ThisMonth(state.services.clock().DateOnly());
        state.documents.Orders = range;
        state.documents.Deliveries = range;
        state.documents.Invoices = range;
    });
    base::IgnoreErrors([&] { state.templates.PriceQueryText = data::DefaultPriceQueryText(); });
    base::IgnoreErrors([&] { state.services.settings.Load(); });
    state.LookAtSettings();
    state.initialised = true;
    base::IgnoreErrors([&] { WriteLog(state, "++ZEBTell+initialized++", log_Normal); });
}

void WebClass_BeginRequest(SessionState& state, web::Call& call) {
    base::IgnoreErrors([&] {
        state.LookAtSettings();
        state.SessionID = call.SessionID();
        WriteLog(state, "+Req+beg+ " + call.request.ServerVariables("QUERY_STRING"), log_Debug);
    });
}

void WebClass_Start(SessionState&, web::Call& call) {
    call.NextItem("Logon");
}

void WebClass_EndRequest(SessionState& state, web::Call& call) {
    WriteLog(state, "-Req-end- " + call.request.ServerVariables("QUERY_STRING"), log_Debug);
}

void WebClass_FatalErrorResponse(SessionState& state,
                                 web::Call&,
                                 const std::exception& error,
                                 bool&) {
    const ErrorText text = DescribeError(error);
    WriteLog(state,
             UserPart(state) + " [fatal] error #" + text.number + "\r\n" + text.description,
             log_Normal);
    if (state.logon.LoggedOn) ResetUserState(state);
}

void WebClass_Terminate(SessionState& state) {
    WriteLog(state, "--ZEBTell-terminated--", log_Normal);
    ResetUserState(state);
}

web::WebClass<SessionState> WebClassHooks() {
    return {.BeginRequest = WebClass_BeginRequest,
            .Start = WebClass_Start,
            .EndRequest = WebClass_EndRequest,
            .FatalErrorResponse = WebClass_FatalErrorResponse,
            .Terminate = WebClass_Terminate,
            .StandingOf = StandingOf,
            .CheckLogon = CheckLogon,
            .Language = [](const SessionState& state) {
                return LanguageCode(state.settings()->language());
            }};
}

std::unique_ptr<SessionState> NewSession(Services& services) {
    auto state = std::make_unique<SessionState>(services);
    WebClass_Initialize(*state);
    return state;
}

}  // namespace zebtell::host
