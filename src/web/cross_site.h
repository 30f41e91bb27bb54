#pragma once

#include "http/message.h"

namespace zebtell::web {

// Whether another site made the browser send this: Sec-Fetch-Site says so, or Origin, else Referer,
// names another host than Host. A browser that sends none of them, as it may over plain HTTP for a
// link whose site wants it so, could come from anywhere. Other programs are believed: nobody can
// make them send a customer's cookie.
bool IsCrossSite(const http::Request& request);

}  // namespace zebtell::web
