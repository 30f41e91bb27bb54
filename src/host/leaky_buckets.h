#pragma once

#include <chrono>
#include <cstddef>
#include <list>
#include <unordered_map>

#include "web/session_token.h"

namespace zebtell::host {

// Counts events by key, each key's count falling with time. Bounded: beyond `most_keys` the key
// whose last event is the oldest is forgotten. Not thread-safe.
class LeakyBuckets {
  public:
    using Key = web::TokenKey;
    using Time = std::chrono::steady_clock::time_point;

    struct Rule {
        double room = 0;        // events that may come at once
        double per_minute = 0;  // how many of them are forgotten in a minute
    };

    LeakyBuckets(Rule rule, std::size_t most_keys) : rule_(rule), most_keys_(most_keys) {}

    // How long until there is room for one more event; 0: now.
    std::chrono::seconds WaitFor(const Key& key, Time now) const;
    void Add(const Key& key, Time now);
    void TakeBack(const Key& key, Time now);  // as if the last Add had not been

    std::size_t size() const { return buckets_.size(); }

  private:
    struct Bucket {
        Key key;
        double level = 0;
        Time at;
    };
    using Buckets = std::list<Bucket>;  // the oldest first

    double LevelAt(const Bucket& bucket, Time now) const;

    const Rule rule_;
    const std::size_t most_keys_;
    Buckets buckets_;
    std::unordered_map<Key, Buckets::iterator, web::TokenKeyHash> by_key_;
};

}  // namespace zebtell::host
