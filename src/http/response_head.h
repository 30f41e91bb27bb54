#pragma once

#include <ctime>
#include <optional>
#include <string>
#include <string_view>

#include "http/message.h"

namespace zebtell::http {

// How the connection goes on behind a response, for its Connection header.
enum class After { kKeepAlive, kKeepAliveHttp10, kClose };

// How a response goes out.
struct Sending {
    After after = After::kClose;
    bool secure = false;  // over TLS, here or at a trusted proxy
};

// Appends the status line and all headers of a response, the empty line included. `date` is the
// value of the Date header. What makes browsers strict goes with every response, whoever made it,
// unless it brings a header of that name itself.
void AppendHead(std::string& out, const Response& response, std::string_view date, Sending how);

// Whether a response of that status has a body at all.
bool HasBody(int status);

// What is answered to a request that no handler gets to see, or that its handler left unanswered.
Response ErrorResponse(int status);

// The Date header's value, made anew once a second. For one thread.
class DateHeader {
  public:
    std::string_view Now();

  private:
    std::optional<std::time_t> second_;
    std::string text_;
};

}  // namespace zebtell::http
