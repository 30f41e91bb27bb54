#include "http/client_address.h"

#include <arpa/inet.h>

#include <algorithm>
#include <charconv>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::http {
namespace {

constexpr std::array<std::uint8_t, 12> kV4Prefix = {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0xff, 0xff};

std::string_view TrimmedTabs(std::string_view text) {
    while (!text.empty() && (text.front() == ' ' || text.front() == '\t')) text.remove_prefix(1);
    while (!text.empty() && (text.back() == ' ' || text.back() == '\t')) text.remove_suffix(1);
    return text;
}

// All values of a header that may come several times, each of them a list, in order.
std::vector<std::string_view> ListValues(const Request& request, std::string_view name) {
    std::vector<std::string_view> values;
    for (const auto& [header, value] : request.headers) {
        if (!base::EqualNoCase(header, name)) continue;
        for (const std::string_view part : base::Split(value, ',')) {
            values.push_back(TrimmedTabs(part));
        }
    }
    return values;
}

// "10.0.0.1", "10.0.0.1:4711", "[fd00::1]:4711", "fd00::1"
std::string_view WithoutPort(std::string_view text) {
    if (text.starts_with('[')) return text.substr(1, text.find(']') - 1);
    const std::size_t colon = text.find(':');
    const bool has_port = colon != std::string_view::npos && colon == text.rfind(':');
    return has_port ? text.substr(0, colon) : text;
}

}  // namespace

std::optional<IpAddress> IpAddress::Parse(std::string_view text) {
    const std::string terminated(text);
    IpAddress address;
    std::uint8_t* const bytes = address.bytes_.data();
    if (inet_pton(AF_INET, terminated.c_str(), bytes + kV4Prefix.size()) == 1) {
        std::copy(kV4Prefix.begin(), kV4Prefix.end(), bytes);
        return address;
    }
    if (inet_pton(AF_INET6, terminated.c_str(), bytes) == 1) return address;
    return {};
}

bool IpAddress::IsV4() const {
    return std::equal(kV4Prefix.begin(), kV4Prefix.end(), bytes_.begin());
}

bool IpAddress::IsLoopback() const {
    constexpr std::array<std::uint8_t, 16> kV6Loopback = {
        0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1};
    return IsV4() ? bytes_[kV4Prefix.size()] == 127 : bytes_ == kV6Loopback;
}

IpAddress IpAddress::Network() const {
    IpAddress network = *this;
    if (!IsV4()) std::fill(network.bytes_.begin() + 8, network.bytes_.end(), std::uint8_t{0});
    return network;
}

std::string IpAddress::ToText() const {
    std::array<char, INET6_ADDRSTRLEN> text{};
    if (IsV4()) {
        inet_ntop(AF_INET, bytes_.data() + kV4Prefix.size(), text.data(), text.size());
    } else {
        inet_ntop(AF_INET6, bytes_.data(), text.data(), text.size());
    }
    return text.data();
}

bool IpAddress::SharesPrefix(const IpAddress& other, int bits) const {
    const auto whole = static_cast<std::size_t>(bits / 8);
    if (!std::equal(bytes_.begin(), bytes_.begin() + bits / 8, other.bytes_.begin())) return false;
    const int rest = bits % 8;
    return rest == 0 || (bytes_[whole] ^ other.bytes_[whole]) >> (8 - rest) == 0;
}

TrustedProxies::TrustedProxies(const std::vector<std::string>& networks) {
    for (const std::string& text : networks) {
        const std::size_t slash = text.find('/');
        const auto address = IpAddress::Parse(text.substr(0, slash));
        const auto fail = [&] {
            throw base::RuntimeError(base::errors::kInvalidCall,
                                     "\"" + text + "\" is not an address or network");
        };
        if (!address) fail();
        const int width = address->IsV4() ? 32 : 128;
        int bits = width;
        if (slash != std::string::npos) {
            const char* const end = text.data() + text.size();
            const auto [stop, error] = std::from_chars(text.data() + slash + 1, end, bits);
            if (error != std::errc() || stop != end || bits < 0 || bits > width) fail();
        }
        networks_.push_back({*address, 128 - width + bits});
    }
}

bool TrustedProxies::Contains(const IpAddress& address) const {
    return std::any_of(networks_.begin(), networks_.end(), [&](const Network& network) {
        return address.SharesPrefix(network.address, network.bits);
    });
}

bool TrustedProxies::Contains(std::string_view address) const {
    if (networks_.empty()) return false;
    const auto parsed = IpAddress::Parse(address);
    return parsed && Contains(*parsed);
}

void TrustedProxies::SetClient(Request& request, const std::string& peer, bool over_tls) const {
    request.remote_address = peer;
    request.secure = over_tls;
    if (!Contains(peer)) return;
    const auto protocols = ListValues(request, "X-Forwarded-Proto");
    if (!protocols.empty()) request.secure = base::EqualNoCase(protocols.back(), "https");
    // Each proxy appends whom it heard; what stands left of the first stranger may be made up.
    const auto addresses = ListValues(request, "X-Forwarded-For");
    for (auto it = addresses.rbegin(); it != addresses.rend(); ++it) {
        const auto address = IpAddress::Parse(WithoutPort(*it));
        if (!address) break;
        request.remote_address = address->ToText();
        if (!Contains(*address)) break;
    }
}

}  // namespace zebtell::http
