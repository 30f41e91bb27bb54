#include "tags/page_globals.h"

#include "base/ignore_errors.h"
#include "host/web_class.h"

namespace zebtell::tags {

thread_local std::string PageLanguage;
thread_local bool IDCardLogon = false;

void ResetPageGlobals(const host::Settings& settings) {
    PageLanguage.clear();
    IDCardLogon = settings.ESTEID.IsOn;
}

web::WebClass<host::SessionState> WebClassHooks() {
    auto hooks = host::WebClassHooks();
    hooks.BeginRequest = [](host::SessionState& state, web::Call& call) {
        host::WebClass_BeginRequest(state, call);
        base::IgnoreErrors([&] { ResetPageGlobals(*state.settings()); });
    };
    return hooks;
}

}  // namespace zebtell::tags
