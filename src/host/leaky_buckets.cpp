#include "host/leaky_buckets.h"

#include <algorithm>
#include <cmath>

namespace zebtell::host {

double LeakyBuckets::LevelAt(const Bucket& bucket, Time now) const {
    const std::chrono::duration<double, std::ratio<60>> minutes = now - bucket.at;
    return std::max(0.0, bucket.level - minutes.count() * rule_.per_minute);
}

std::chrono::seconds LeakyBuckets::WaitFor(const Key& key, Time now) const {
    const auto found = by_key_.find(key);
    if (found == by_key_.end()) return std::chrono::seconds(0);
    const double over = LevelAt(*found->second, now) + 1 - rule_.room;
    if (over <= 0) return std::chrono::seconds(0);
    return std::chrono::seconds(static_cast<std::int64_t>(std::ceil(over / rule_.per_minute * 60)));
}

void LeakyBuckets::Add(const Key& key, Time now) {
    const auto found = by_key_.find(key);
    if (found != by_key_.end()) {
        Bucket& bucket = *found->second;
        bucket = {key, LevelAt(bucket, now) + 1, now};
        buckets_.splice(buckets_.end(), buckets_, found->second);
        return;
    }
    if (buckets_.size() >= most_keys_) {
        by_key_.erase(buckets_.front().key);
        buckets_.pop_front();
    }
    by_key_.emplace(key, buckets_.insert(buckets_.end(), {key, 1, now}));
}

void LeakyBuckets::TakeBack(const Key& key, Time now) {
    const auto found = by_key_.find(key);
    if (found == by_key_.end()) return;
    Bucket& bucket = *found->second;
    bucket.level = std::max(0.0, LevelAt(bucket, now) - 1);
    bucket.at = now;
}

}  // namespace zebtell::host
