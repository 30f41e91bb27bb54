#pragma once

#include <cstddef>
#include <mutex>
#include <string>
#include <unordered_map>

namespace zebtell::http {

// How many connections are open, in all and per peer address. For any thread.
class ConnectionCount {
  public:
    // Counts a connection in unless there are too many. `most_per_address` 0: no limit for this
    // peer.
    bool Enter(const std::string& peer, std::size_t most, std::size_t most_per_address) {
        const std::lock_guard lock(mutex_);
        if (total_ >= most) return false;
        std::size_t& of_peer = by_peer_[peer];
        if (most_per_address > 0 && of_peer >= most_per_address) return false;
        ++of_peer;
        ++total_;
        return true;
    }

    void Leave(const std::string& peer) {
        const std::lock_guard lock(mutex_);
        const auto found = by_peer_.find(peer);
        if (--found->second == 0) by_peer_.erase(found);
        --total_;
    }

    std::size_t Total() const {
        const std::lock_guard lock(mutex_);
        return total_;
    }

  private:
    mutable std::mutex mutex_;
    std::size_t total_ = 0;
    std::unordered_map<std::string, std::size_t> by_peer_;
};

}  // namespace zebtell::http
