#pragma once

#include <memory>

#include "http/message.h"

namespace zebtell::http {

class Connection;

// A responder for the request that the connection is handling. The first call counts; when there
// is none before the last copy is gone, the client gets 500.
Responder MakeResponder(std::weak_ptr<Connection> connection);

}  // namespace zebtell::http
