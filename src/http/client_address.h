#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "http/message.h"

namespace zebtell::http {

// An IP address. An IPv4 address that came over IPv6 ("::ffff:10.0.0.1") is the IPv4 address.
class IpAddress {
  public:
    static std::optional<IpAddress> Parse(std::string_view text);

    std::string ToText() const;
    bool IsV4() const;
    bool IsLoopback() const;
    // What one customer holds: an IPv4 address alone, of IPv6 the /64 network.
    IpAddress Network() const;
    // Whether the first `bits` of both are the same; counted from the start of the 128-bit form.
    bool SharesPrefix(const IpAddress& other, int bits) const;

    friend bool operator==(const IpAddress&, const IpAddress&) = default;

  private:
    std::array<std::uint8_t, 16> bytes_{};  // IPv4 as ::ffff:a.b.c.d
};

// The proxies whose word about their clients is taken.
class TrustedProxies {
  public:
    TrustedProxies() = default;
    // Addresses and networks: "127.0.0.1", "10.0.0.0/8", "fd00::/8". RuntimeError for other text.
    explicit TrustedProxies(const std::vector<std::string>& networks);

    bool Contains(std::string_view address) const;

    // Sets remote_address and secure of a request that a peer sent: from X-Forwarded-For (the
    // right-most address that is no trusted proxy) and X-Forwarded-Proto when the peer is one.
    void SetClient(Request& request, const std::string& peer, bool over_tls) const;

  private:
    struct Network {
        IpAddress address;
        int bits = 0;
    };
    bool Contains(const IpAddress& address) const;

    std::vector<Network> networks_;
};

}  // namespace zebtell::http
