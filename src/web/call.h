#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <utility>

#include "markup/tag.h"
#include "web/request.h"
#include "web/response.h"

namespace zebtell::web {

// One request while its page's handlers answer it: what they read, and what they may ask of the
// page runtime. Lives until the request ends; used by one thread at a time.
class Call {
  public:
    // What the runtime does for a call.
    struct Runtime {
        // Writes the current page's template into the response, raising its ProcessTag.
        std::function<void(Call&)> write_template;
        // RuntimeError 5 for a page that is not in the table.
        std::function<std::string(std::string_view page, std::string_view event)> url_for;
    };

    Call(const Request& request, Response& response, const Runtime& runtime, std::string session_id)
        : request(request),
          response(response),
          session_id_(std::move(session_id)),
          runtime_(runtime) {}

    const Request& request;
    Response& response;

    // The page whose handler runs now, in the letters of the page table.
    std::string_view PageName() const { return page_name_; }
    // The number that stands for the session in the log; not the cookie's token.
    const std::string& SessionID() const { return session_id_; }

    void WriteTemplate() { runtime_.write_template(*this); }

    // The page whose Respond runs when this handler has ended; behind a post the browser asks for
    // it.
    void NextItem(std::string_view page) { next_item_ = page; }

    // "/?page=Kaubainfo&event=Tellimus"; more parameters are appended as "&ID=5". Event names made
    // of data are percent-encoded.
    std::string URLFor(std::string_view page, std::string_view event = {}) const {
        return runtime_.url_for(page, event);
    }
    void RedirectTo(std::string_view page, std::string_view event = {}) {
        response.Redirect(URLFor(page, event));
    }

    // The session's instance ends with this request; the browser's next request gets a fresh one.
    void ReleaseInstance() { release_instance_ = true; }
    // The session goes on under a new cookie: whoever knew the old one is out.
    void RenewToken() { renew_token_ = true; }

    // For the page runtime.
    void SetPage(std::string_view page_name) { page_name_ = page_name; }
    bool HasNextItem() const { return !next_item_.empty(); }
    std::string TakeNextItem() { return std::exchange(next_item_, {}); }
    bool release_instance() const { return release_instance_; }
    bool renew_token() const { return renew_token_; }

  private:
    std::string_view page_name_;
    std::string session_id_;
    std::string next_item_;
    bool release_instance_ = false;
    bool renew_token_ = false;
    const Runtime& runtime_;
};

}  // namespace zebtell::web
