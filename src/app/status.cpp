#include "app/status.h"

#include <string>

#include "base/ignore_errors.h"
#include "http/client_address.h"

namespace zebtell::app {
namespace {

http::Response Plain(int status, std::string text) {
    http::Response response;
    response.status = status;
    response.headers = {{"Content-Type", "text/plain; charset=utf-8"},
                        {"Cache-Control", "no-store"}};
    response.body = std::move(text);
    return response;
}

bool IsLoopback(std::string_view address) {
    const auto parsed = http::IpAddress::Parse(address);
    return parsed && parsed->IsLoopback();
}

void AppendMetric(std::string& out,
                  std::string_view name,
                  std::string_view type,
                  std::string_view help,
                  std::uint64_t value) {
    out.append("# HELP zebtell_").append(name).append(" ").append(help);
    out.append("\n# TYPE zebtell_").append(name).append(" ").append(type);
    out.append("\nzebtell_").append(name).append(" ").append(std::to_string(value)).append("\n");
}

}  // namespace

std::optional<http::Response> Status::Serve(const http::Request& request) {
    requests_.fetch_add(1, std::memory_order_relaxed);
    const std::string_view path = request.Path();
    if (path != "/healthz" && path != "/metrics") return std::nullopt;
    if (!sources_.is_public && !IsLoopback(request.remote_address)) return std::nullopt;
    return path == "/healthz" ? Health() : Metrics();
}

http::Response Status::Health() const {
    const auto settings = sources_.settings.Current();
    const bool database = sources_.databases.IsReachable(settings->Type, settings->Path);
    const bool templates = base::IgnoreErrors([&] { sources_.templates.Get("zebtell_logon.htm"); });
    const std::string text = std::string("database ") + (database ? "ok" : "not reachable") +
                             "\ntemplates " + (templates ? "ok" : "not readable") + "\n";
    return Plain(database && templates ? 200 : 503, text);
}

http::Response Status::Metrics() const {
    const auto sessions = sources_.count_sessions();
    std::string out;
    AppendMetric(out, "requests_total", "counter", "Requests since the start.", requests_);
    AppendMetric(out, "sessions", "gauge", "Sessions that stand open.", sessions.all);
    AppendMetric(
        out, "sessions_logged_on", "gauge", "Sessions of logged-on users.", sessions.logged_on);
    return Plain(200, std::move(out));
}

}  // namespace zebtell::app
