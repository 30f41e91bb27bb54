#include "http/target.h"

#include <algorithm>
#include <string>

#include "http/url.h"

namespace zebtell::http {
namespace {

bool IsTargetCharacter(char c) {
    return c > ' ' && c < '\x7f' && c != '#';
}

bool IsControl(char c) {
    return static_cast<unsigned char>(c) < ' ' || c == '\x7f';
}

bool HasDotSegment(std::string_view path) {
    while (!path.empty()) {
        const std::size_t end = std::min(path.find_first_of("/\\"), path.size());
        const std::string_view segment = path.substr(0, end);
        if (segment == "." || segment == "..") return true;
        path.remove_prefix(std::min(end + 1, path.size()));
    }
    return false;
}

bool IsHostCharacter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') ||
           std::string_view("-._~:[]").find(c) != std::string_view::npos;
}

}  // namespace

bool IsAcceptableTarget(std::string_view target) {
    if (target.empty() || target.front() != '/') return false;
    if (!std::all_of(target.begin(), target.end(), IsTargetCharacter)) return false;
    const std::string_view path = target.substr(0, target.find('?'));
    if (path.find_first_of("%.\\") == std::string_view::npos) return true;
    const std::string decoded = DecodePath(path);
    return !HasDotSegment(decoded) && std::none_of(decoded.begin(), decoded.end(), IsControl);
}

bool IsAcceptableHost(std::string_view host) {
    return !host.empty() && std::all_of(host.begin(), host.end(), IsHostCharacter);
}

}  // namespace zebtell::http
