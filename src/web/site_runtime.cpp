#include "web/site_runtime.h"

#include <thread>
#include <utility>
#include <variant>

#include "base/runtime_error.h"
#include "http/content_coding.h"
#include "web/cross_site.h"
#include "web/plain_page.h"
#include "web/request_reader.h"
#include "web/session_cookie.h"

namespace zebtell::web {
namespace {

constexpr auto kSweepPeriod = std::chrono::seconds(15);

RuntimeOptions Checked(RuntimeOptions options) {
    if (!options.base_path.starts_with('/'))
        throw base::RuntimeError(base::errors::kInvalidCall, "The base path must begin with /");
    if (options.worker_threads == 0) options.worker_threads = std::thread::hardware_concurrency();
    return options;
}

bool Changes(const Request& request, const SitePage* page) {
    return request.method == "POST" ||
           (page != nullptr && page->EffectOf(request.event) == Effect::kChanges);
}

void Pack(http::Response& response, http::Coding coding) {
    if (response.body.size() < http::kLeastWorthCoding) return;
    response.headers.emplace_back("Vary", "Accept-Encoding");
    if (coding == http::Coding::kIdentity) return;
    response.body = http::Encoded(response.body, coding, http::Effort::kQuick);
    response.headers.emplace_back("Content-Encoding", http::CodingName(coding));
}

}  // namespace

// A page request on its way through its session's queue.
struct SiteRuntime::Job {
    Request request;
    http::Responder respond;
    std::shared_ptr<Session> session;
    std::string new_token;  // to be sent as a cookie; "": the browser has it
    bool secure = false;
    http::Coding coding = http::Coding::kIdentity;
    std::shared_ptr<void> place;  // among the log-ons, where it is one
};

SiteRuntime::SiteRuntime(Site site, markup::TemplateCache& templates, RuntimeOptions options)
    : site_(std::move(site)),
      options_(Checked(std::move(options))),
      context_{site_, templates, options_.base_path},
      pool_(options_.worker_threads, options_.worker_threads / 2),
      sessions_(
          pool_,
          {options_.session_idle, options_.max_sessions, options_.queue_limit, options_.clock}) {
    pool_.Every(kSweepPeriod, [this] { sessions_.TakeExpired(); });
}

SiteRuntime::~SiteRuntime() {
    Stop();
}

void SiteRuntime::Stop() {
    pool_.Stop();
    sessions_.TakeAll();
}

void SiteRuntime::Handle(const http::Request& request, http::Responder respond) {
    if (options_.static_files) {
        if (auto response = options_.static_files(request)) return respond(std::move(*response));
    }
    auto parsed = ParseRequest(request, options_.base_path);
    if (const auto* refusal = std::get_if<Refusal>(&parsed))
        return respond(PlainPage(refusal->status));
    Request& page_request = std::get<Request>(parsed);
    const SitePage* page = site_.Find(page_request.page);
    if (page == nullptr && !page_request.page.empty()) return respond(PlainPage(404));
    if (Changes(page_request, page) && IsCrossSite(request)) return respond(PlainPage(403));

    auto job = std::make_shared<Job>();
    job->session = SessionFor(request, job->new_token);
    if (job->session == nullptr) return respond(PlainPage(503));
    job->request = std::move(page_request);
    job->respond = std::move(respond);
    job->secure = request.secure;
    // What another site asked for in the customer's name is sent as it is: its packed length would
    // tell that site how much of what it chose stands in the page.
    if (!IsCrossSite(request))
        job->coding =
            http::BestCoding(request.HeaderValue("Accept-Encoding"), http::Effort::kQuick);
    const Work work = WorkOf(job->request);
    if (work == Work::kLogOn) {
        job->place = TakePlace();
        if (job->place == nullptr) return job->respond(PlainPage(503));
    }
    if (!job->session->queue->Submit([this, job] { Run(*job); }, work))
        job->respond(PlainPage(503));
}

std::shared_ptr<Session> SiteRuntime::SessionFor(const http::Request& request,
                                                 std::string& new_token) {
    for (const std::string_view token : SessionTokens(request))
        if (auto session = sessions_.Find(token)) return session;
    auto created = sessions_.Create();
    if (!created) return nullptr;
    // Ending an instance can wait, so not here.
    if (created->evicted != nullptr) pool_.Post([gone = std::move(created->evicted)] {});
    new_token = std::move(created->token);
    return created->session;
}

// A place among the log-ons until the last copy is gone; null: all are taken.
std::shared_ptr<void> SiteRuntime::TakePlace() {
    if (log_ons_.fetch_add(1) < options_.most_log_ons)
        return {this, [](SiteRuntime* runtime) { runtime->log_ons_.fetch_sub(1); }};
    log_ons_.fetch_sub(1);
    return nullptr;
}

Work SiteRuntime::WorkOf(const Request& request) const {
    const SitePage* page = site_.Find(request.page);
    const SiteEvent* event = page == nullptr ? nullptr : page->FindEvent(request.event);
    const Work work = event == nullptr ? Work::kQuick : event->work;
    return work == Work::kQuick && !options_.quick_on_io_threads ? Work::kMayWait : work;
}

void SiteRuntime::Run(Job& job) {
    http::Response response;
    try {
        response = RunPage(job);
        Pack(response, job.coding);
    } catch (const std::exception& error) {
        // The pages' own errors have ended within the cycle.
        if (options_.log) options_.log(error.what());
        response = PlainPage(500);
    }
    if (!job.new_token.empty()) {
        response.headers.emplace_back("Set-Cookie",
                                      SessionCookie(job.new_token, options_.base_path, job.secure));
    }
    job.respond(std::move(response));
}

http::Response SiteRuntime::RunPage(Job& job) {
    Session& session = *job.session;
    if (session.instance == nullptr) session.instance = site_.hooks().make_instance();
    CycleResult result = RunCycle(context_, job.request, *session.instance, session.session_id);
    if (result.renew_token) {
        if (auto token = sessions_.RenewToken(session)) job.new_token = std::move(*token);
    }
    if (result.release_instance) session.instance.reset();
    const auto& standing_of = site_.hooks().standing_of;
    sessions_.Touch(session,
                    session.instance != nullptr && standing_of ? standing_of(*session.instance)
                                                               : Standing::kAnonymous);
    return std::move(result.response);
}

}  // namespace zebtell::web
