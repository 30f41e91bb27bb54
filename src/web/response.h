#pragma once

#include <string>
#include <string_view>

#include "http/message.h"

namespace zebtell::web {

// What a page answers. Buffered until the handler ends, so that everything may be said at any time.
class Response {
  public:
    void Write(std::string_view text) { body_ += text; }
    std::string& body() { return body_; }
    // Sends the browser to another address (status 303); what was written is not shown.
    void Redirect(std::string address);
    void AddHeader(std::string name, std::string value);
    void SetCacheControl(std::string value);
    void SetExpires(int minutes);  // negative: expired already
    void SetStatus(int status);
    // Forgets what was written, the redirect and the status; headers stay.
    void Clear();

    bool IsRedirect() const { return !redirect_.empty(); }
    const std::string& redirect_address() const { return redirect_; }
    bool IsEmpty() const { return body_.empty() && redirect_.empty(); }

    // The finished response; empties this one.
    http::Response Take();

  private:
    int status_ = 200;
    std::string body_;
    std::string redirect_;
    std::string cache_control_;
    int expires_minutes_ = 0;
    bool has_expires_ = false;
    std::vector<http::Header> headers_;
};

}  // namespace zebtell::web
