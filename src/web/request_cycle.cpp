#include "web/request_cycle.h"

#include <stdexcept>

#include "base/ignore_errors.h"
#include "base/runtime_error.h"
#include "http/url.h"
#include "web/plain_page.h"

namespace zebtell::web {
namespace {

// Pages that hand a request on and on end here.
constexpr int kMaxNextItems = 10;

class Cycle {
  public:
    Cycle(const CycleContext& context,
          const Request& request,
          SessionInstance& instance,
          const std::string& session_id)
        : context_(context),
          hooks_(context.site.hooks()),
          instance_(instance),
          runtime_{[this](Call&) { WriteTemplate(); },
                   [this](std::string_view page, std::string_view event) {
                       return UrlFor(page, event);
                   }},
          call_(request, response_, runtime_, session_id) {}

    CycleResult Run() {
        Guarded([this] {
            if (hooks_.begin_request) hooks_.begin_request(instance_, call_);
            Dispatch();
        });
        Guarded([this] {
            if (hooks_.end_request) hooks_.end_request(instance_, call_);
        });
        return {response_.Take(), call_.release_instance(), call_.renew_token()};
    }

  private:
    void Dispatch() {
        if (call_.request.page.empty()) {
            if (hooks_.start) hooks_.start(instance_, call_);
        } else {
            Enter(call_.request.page);
            if (Admits()) Raise(call_.request.event);
        }
        FollowNextItems();
    }

    // The request's event, or Respond without one.
    void Raise(const std::string& event) {
        if (event.empty()) return Respond();
        if (const SiteEvent* custom = page_->FindEvent(event)) {
            custom->handle(instance_, call_);
        } else if (page_->user_event) {
            page_->user_event(instance_, call_, event);
        }
        if (response_.IsEmpty() && !call_.HasNextItem()) WriteTemplate();
    }

    void Respond() {
        if (page_->respond) {
            page_->respond(instance_, call_);
        } else {
            WriteTemplate();
        }
    }

    // Behind a post the browser is sent on, so that reload and back do not post again.
    void FollowNextItems() {
        if (call_.HasNextItem() && call_.request.method == "POST") {
            response_.Redirect(UrlFor(call_.TakeNextItem(), {}));
            return;
        }
        for (int hops = 0; call_.HasNextItem(); ++hops) {
            if (hops == kMaxNextItems)
                throw base::RuntimeError(base::errors::kInvalidCall, "Too many next items");
            Enter(call_.TakeNextItem());
            if (Admits()) Respond();
        }
    }

    void Enter(std::string_view name) {
        page_ = &Known(name);
        call_.SetPage(page_->name);
    }

    bool Admits() {
        if (page_->rules.visitors == Visitors::kEverybody || !hooks_.check_logon) return true;
        return hooks_.check_logon(instance_, call_);
    }

    const SitePage& Known(std::string_view name) const {
        const SitePage* page = context_.site.Find(name);
        if (page == nullptr)
            throw base::RuntimeError(base::errors::kInvalidCall, "There is no such page");
        return *page;
    }

    void WriteTemplate() {
        if (page_ == nullptr)
            throw base::RuntimeError(base::errors::kInvalidCall, "No page to write");
        const auto language = hooks_.language ? hooks_.language(instance_) : std::string_view{};
        const auto page = context_.templates.Get(page_->template_file, language);
        std::string& body = response_.body();
        body.reserve(body.size() + 2 * page->text().size());
        const auto process_tag = [this](markup::Tag& tag) {
            if (page_->process_tag) page_->process_tag(instance_, call_, tag);
        };
        markup::Expand(*page, process_tag, body);
    }

    std::string UrlFor(std::string_view page, std::string_view event) const {
        std::string url = context_.base_path + "?page=" + http::EncodeComponent(Known(page).name);
        if (!event.empty()) url += "&event=" + http::EncodeComponent(event);
        return url;
    }

    // The one place where handlers' errors are caught.
    template <class Work>
    void Guarded(Work&& work) {
        try {
            work();
        } catch (const std::exception& error) {
            SendFatalError(error);
        } catch (...) {
            SendFatalError(std::runtime_error("Unknown error"));
        }
    }

    void SendFatalError(const std::exception& error) {
        response_.Clear();
        bool send_default = true;
        const bool told = base::IgnoreErrors([&] {
            if (hooks_.fatal) hooks_.fatal(instance_, call_, error, send_default);
        });
        if (told && !send_default) return;
        response_.Clear();
        response_.SetStatus(500);
        response_.Write(PlainPageHtml(500));
    }

    const CycleContext& context_;
    const SiteHooks& hooks_;
    SessionInstance& instance_;
    const SitePage* page_ = nullptr;  // whose handler runs
    Response response_;
    const Call::Runtime runtime_;
    Call call_;
};

}  // namespace

CycleResult RunCycle(const CycleContext& context,
                     const Request& request,
                     SessionInstance& instance,
                     const std::string& session_id) {
    return Cycle(context, request, instance, session_id).Run();
}

}  // namespace zebtell::web
