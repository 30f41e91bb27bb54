#include "web/cross_site.h"

#include "base/text.h"

namespace zebtell::web {
namespace {

std::string_view WithoutPort(std::string_view host, std::string_view default_port) {
    if (host.ends_with(default_port)) host.remove_suffix(default_port.size());
    return host;
}

bool IsOtherOrigin(std::string_view origin, std::string_view host) {
    const std::size_t mark = origin.find("://");
    if (mark == origin.npos) return true;  // "null": from nowhere that could be ours
    const std::string_view port =
        base::EqualNoCase(origin.substr(0, mark), "https") ? ":443" : ":80";
    return !base::EqualNoCase(WithoutPort(origin.substr(mark + 3), port), WithoutPort(host, port));
}

}  // namespace

bool IsCrossSite(const http::Request& request) {
    const std::string_view site = request.HeaderValue("Sec-Fetch-Site");
    if (base::EqualNoCase(site, "cross-site") || base::EqualNoCase(site, "same-site")) return true;
    const std::string_view origin = request.HeaderValue("Origin");
    return !origin.empty() && IsOtherOrigin(origin, request.HeaderValue("Host"));
}

}  // namespace zebtell::web
