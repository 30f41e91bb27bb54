#include "web/cross_site.h"

#include "base/text.h"

namespace zebtell::web {
namespace {

std::string_view WithoutPort(std::string_view host, std::string_view default_port) {
    if (host.ends_with(default_port)) host.remove_suffix(default_port.size());
    return host;
}

// `from` is an origin or a whole address.
bool IsOtherOrigin(std::string_view from, std::string_view host) {
    const std::size_t mark = from.find("://");
    if (mark == from.npos) return true;  // "null": from nowhere that could be ours
    const std::string_view port = base::EqualNoCase(from.substr(0, mark), "https") ? ":443" : ":80";
    from.remove_prefix(mark + 3);
    from = from.substr(0, from.find('/'));
    return !base::EqualNoCase(WithoutPort(from, port), WithoutPort(host, port));
}

bool IsBrowser(const http::Request& request) {
    return base::StartsWithNoCase(request.HeaderValue("User-Agent"), "Mozilla/");
}

}  // namespace

bool IsCrossSite(const http::Request& request) {
    const std::string_view site = request.HeaderValue("Sec-Fetch-Site");
    const bool is_own = base::EqualNoCase(site, "same-origin") || base::EqualNoCase(site, "none");
    if (!site.empty() && !is_own) return true;
    for (const std::string_view name : {"Origin", "Referer"}) {
        const std::string_view from = request.HeaderValue(name);
        if (!from.empty()) return IsOtherOrigin(from, request.HeaderValue("Host"));
    }
    return site.empty() && IsBrowser(request);
}

}  // namespace zebtell::web
