#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace zebtell::http {

using Header = std::pair<std::string, std::string>;

// A request as it was read from the wire, checked and bounded. Plain values, owned.
struct Request {
    std::string method;  // "GET", "HEAD", "POST"
    std::string target;  // path and query, not decoded, without host
    std::vector<Header> headers;
    std::string body;
    std::string remote_address;  // the client's, behind a trusted proxy the forwarded one
    bool secure = false;         // over TLS, here or at a trusted proxy

    // The first header of that name (names ignore case), "" when there is none.
    std::string_view HeaderValue(std::string_view name) const;
    std::string_view Path() const;   // target up to the "?"
    std::string_view Query() const;  // what follows it
};

struct Response {
    int status = 200;
    std::vector<Header> headers;  // without Content-Length, Connection, Date and Server
    std::string body;
    // Sent instead of `body` when it is set: bytes that many responses share.
    std::shared_ptr<const std::string> shared_body;
};

// Answers a request; may be called once, from any thread, also after the client has gone.
using Responder = std::function<void(Response)>;

// Takes a request on an IO thread and must not block it.
using Handler = std::function<void(Request, Responder)>;

}  // namespace zebtell::http
