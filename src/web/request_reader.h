#pragma once

#include <variant>

#include "http/message.h"
#include "web/request.h"

namespace zebtell::web {

// The status to answer instead of running a page.
struct Refusal {
    int status = 400;
};

// The page request that was sent to an address below `base_path` ("/", "/portal"): 404 for other
// addresses, 405 for other methods than GET, HEAD and POST, 400 for a form that can't be read, 413
// for one with too many fields, 415 for a body that is no form.
std::variant<Request, Refusal> ParseRequest(const http::Request& from, std::string_view base_path);

}  // namespace zebtell::web
