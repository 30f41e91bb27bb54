#include "host/logon_limits.h"

#include <algorithm>
#include <optional>
#include <string>

#include "base/text.h"
#include "http/client_address.h"

namespace zebtell::host {
namespace {

using Rule = LeakyBuckets::Rule;

// A person who has forgotten his password types a dozen; a company behind one address has many
// people. Who guesses gets one try a minute for a name from his network, two from all networks.
constexpr Rule kPairRule{.room = 50, .per_minute = 1};
constexpr Rule kNetworkRule{.room = 300, .per_minute = 20};
constexpr Rule kNameRule{.room = 100, .per_minute = 2};
constexpr Rule kKnownRule{.room = 1, .per_minute = 1.0 / (30 * 24 * 60)};

constexpr std::size_t kMostKeys = 20'000;

}  // namespace

struct LogonLimits::Keys {
    Keys(std::string_view user, std::string_view address) {
        const auto parsed = http::IpAddress::Parse(address);
        const std::string place = parsed ? parsed->Network().ToText() : std::string(address);
        const std::string lower = base::Lower(user);
        pair = web::TokenKey::Of(place + "\n" + lower);
        name = web::TokenKey::Of(lower);
        // This machine is a proxy that the settings do not name: everybody comes from it.
        if (!parsed || !parsed->IsLoopback()) network = web::TokenKey::Of(place);
    }

    LeakyBuckets::Key pair;
    LeakyBuckets::Key name;
    std::optional<LeakyBuckets::Key> network;
};

LogonLimits::LogonLimits(Clock clock)
    : clock_(std::move(clock)),
      by_pair_(kPairRule, kMostKeys),
      by_network_(kNetworkRule, kMostKeys),
      by_name_(kNameRule, kMostKeys),
      known_pairs_(kKnownRule, kMostKeys) {}

bool LogonLimits::IsKnown(const Keys& keys, LeakyBuckets::Time now) const {
    return known_pairs_.WaitFor(keys.pair, now) > std::chrono::seconds(0);
}

std::chrono::seconds LogonLimits::Enter(std::string_view user, std::string_view address) {
    const Keys keys(user, address);
    const auto now = clock_();
    const std::lock_guard lock(mutex_);
    const bool is_known = IsKnown(keys, now);
    auto wait = by_pair_.WaitFor(keys.pair, now);
    if (keys.network) wait = std::max(wait, by_network_.WaitFor(*keys.network, now));
    if (!is_known) wait = std::max(wait, by_name_.WaitFor(keys.name, now));
    if (wait > std::chrono::seconds(0)) return wait;
    by_pair_.Add(keys.pair, now);
    if (keys.network) by_network_.Add(*keys.network, now);
    if (!is_known) by_name_.Add(keys.name, now);
    return wait;
}

void LogonLimits::Succeeded(std::string_view user, std::string_view address) {
    const Keys keys(user, address);
    const auto now = clock_();
    const std::lock_guard lock(mutex_);
    by_pair_.TakeBack(keys.pair, now);
    if (keys.network) by_network_.TakeBack(*keys.network, now);
    if (!IsKnown(keys, now)) by_name_.TakeBack(keys.name, now);
    known_pairs_.TakeBack(keys.pair, now);
    known_pairs_.Add(keys.pair, now);
}

}  // namespace zebtell::host
