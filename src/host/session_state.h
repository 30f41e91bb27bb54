#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "data/basket.h"
#include "host/services.h"
#include "host/state/basket_form.h"
#include "host/state/blocking.h"
#include "host/state/catalogue.h"
#include "host/state/company.h"
#include "host/state/confirmation.h"
#include "host/state/documents.h"
#include "host/state/logon.h"
#include "host/state/template_values.h"
#include "web/call.h"
#include "web/page.h"

namespace zebtell::host {

// Everything that belongs to one browser session. One request of a session runs at a time, so
// nothing here is locked.
struct SessionState {
    explicit SessionState(Services& services) : services(services) { LookAtSettings(); }
    SessionState(const SessionState&) = delete;
    SessionState& operator=(const SessionState&) = delete;

    Services& services;  // shared by all sessions, not owned

    std::string SessionID;  // what the log calls this session; not the cookie's token
    std::string Message;    // one line for the user, shown on the next page
    LogonState logon;
    BlockingState blocking;
    CompanyState company;
    CatalogueState catalogue;
    data::BasketValues basket;
    BasketFormState basket_form;
    ConfirmationState confirmation;
    DocumentsState documents;
    TemplateValues templates;
    // The keyed store of the session, made when it is first used; keys ignore case.
    std::unique_ptr<NoCaseMap<std::string>> session_dictionary;
    bool initialised = false;

    // The settings as they were when the request began; hundreds of tags of a page ask for them.
    const Settings* settings() const { return settings_.get(); }
    const base::Region& region() const { return *region_; }
    void LookAtSettings();
    // RuntimeError 91 when nobody is logged on.
    data::DataApplication& application() const;

  private:
    std::shared_ptr<const Settings> settings_;
    const base::Region* region_ = nullptr;
};

using Page = web::Page<SessionState>;

// Appends to the request log; never fails.
void WriteLog(const SessionState& state, std::string_view text, eLogLevels level);

NoCaseMap<std::string>& SessionDictionary(SessionState& state);

// Ends the logged-on state: blocking cleared, every data object released. UserName stays.
void ResetUserState(SessionState& state);

// The guard of every page that needs a user, asked before its handlers run: true when one is logged
// on, else the browser is sent to the Logon page with a message.
bool CheckLogon(SessionState& state, web::Call& call);

// The response is not to be kept by anybody.
void SetNoCache(web::Call& call);

}  // namespace zebtell::host
