#pragma once

#include <chrono>
#include <functional>
#include <mutex>
#include <string_view>

#include "host/leaky_buckets.h"

namespace zebtell::host {

// Slows the guessing of passwords down, whatever sessions it comes from: by name and network, by
// network, and by name. Every name that is typed is treated alike, so it tells nobody which names
// there are. The limit by name alone, which strangers could use to keep a customer out, does not
// bind networks from which that name has logged on within the last month. Memory is bounded, and a
// restart forgets everything. Thread-safe.
class LogonLimits {
  public:
    using Clock = std::function<std::chrono::steady_clock::time_point()>;

    explicit LogonLimits(Clock clock = std::chrono::steady_clock::now);

    // Before the password is looked at: how long to wait, 0: try it. What may be tried is counted
    // as a failure until Succeeded says otherwise, so many at a time are no way around.
    std::chrono::seconds Enter(std::string_view user, std::string_view address);
    void Succeeded(std::string_view user, std::string_view address);

  private:
    struct Keys;

    bool IsKnown(const Keys& keys, LeakyBuckets::Time now) const;

    const Clock clock_;
    std::mutex mutex_;
    LeakyBuckets by_pair_;
    LeakyBuckets by_network_;
    LeakyBuckets by_name_;
    LeakyBuckets known_pairs_;  // one that is not empty: has logged on within a month
};

}  // namespace zebtell::host
