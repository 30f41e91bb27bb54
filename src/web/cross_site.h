#pragma once

#include "http/message.h"

namespace zebtell::web {

// Whether another site made the browser send this: Sec-Fetch-Site says so, or Origin names another
// host than Host. A browser that sends neither header is believed.
bool IsCrossSite(const http::Request& request);

}  // namespace zebtell::web
