#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "data/data_application.h"

namespace zebtell::host {

// Who is logged on.
struct LogonState {
    bool LoggedOn = false;
    // Kept after logout and after a fatal error, so that the guard can tell a logged-off user from
    // a new session.
    std::string UserName;
    bool IsGuest = false;
    std::string Password;    // recognises a repeated log-on with the same credentials
    std::string ReturnPage;  // page to go to after log-on instead of the frameset; empty: none
    bool LostForm =
        false;  // a form came while nobody was logged on, and the user has not been told
    std::unique_ptr<data::DataApplication> Application;  // none: logged off
};

}  // namespace zebtell::host
