#include "host/session_state.h"

#include <utility>

#include "base/runtime_error.h"
#include "host/log.h"

namespace zebtell::host {

void SessionState::LookAtSettings() {
    settings_ = services.settings.Current();
    region_ = &settings_->region();
}

data::DataApplication& SessionState::application() const {
    if (!logon.Application) throw base::RuntimeError(base::errors::kObjectNotSet);
    return *logon.Application;
}

void WriteLog(const SessionState& state, std::string_view text, eLogLevels level) {
    const auto settings = state.settings();
    if (level > settings->Level) return;
    WriteLogEntry(*settings,
                  {state.SessionID, state.logon.LoggedOn, state.logon.IsGuest},
                  state.services.clock(),
                  text,
                  level);
}

NoCaseMap<std::string>& SessionDictionary(SessionState& state) {
    if (!state.session_dictionary) {
        state.session_dictionary = std::make_unique<NoCaseMap<std::string>>();
    }
    return *state.session_dictionary;
}

void ResetUserState(SessionState& state) {
    state.logon.LoggedOn = false;
    state.logon.Password.clear();
    state.logon.ReturnPage.clear();
    state.blocking = {};

    // Whatever was read for one user is gone before another can log on.
    state.basket = {};
    // How typed quantities are rounded is the templates' word, not the user's.
    state.basket_form.QuantityDecimals = std::exchange(state.basket_form, {}).QuantityDecimals;
    state.catalogue = {};
    state.confirmation = {};
    state.company = {};
    state.documents.ShownOrder = {};
    state.documents.ShownConsignment = {};
    state.documents.ShownInvoice = {};
    state.documents.Article.reset();
    state.session_dictionary.reset();
    for (auto& [key, query] : state.templates.Queries) query.ZEBApp = nullptr;
    state.templates.Queries.clear();
    state.templates.SavedValues.reset();
    state.templates.OrdersAllowed = {};
    state.logon.Application.reset();
}

bool CheckLogon(SessionState& state, web::Call& call) {
    if (state.logon.LoggedOn) return true;
    // These two texts are Estonian in every language.
    if (!state.logon.UserName.empty()) {
        WriteLog(state, "Forced to logon - already logged out", log_Normal);
        state.Message = "Palume uuesti siseneda!";
    } else {
        WriteLog(state, "Forced to logon - timeout or bad link", log_Normal);
        state.Message = "Sessioon katkestatud - sisenege uuesti!";
    }
    if (call.request.method == "POST") state.logon.LostForm = true;
    call.RedirectTo("Logon");
    return false;
}

void SetNoCache(web::Call& call) {
    call.response.SetCacheControl("no-cache");
    call.response.AddHeader("Pragma", "no-cache");
    call.response.SetExpires(-1);
}

}  // namespace zebtell::host
