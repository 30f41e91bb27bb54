#pragma once

#include <array>
#include <chrono>
#include <cstdint>
#include <functional>
#include <list>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "web/serial_queue.h"
#include "web/session_token.h"
#include "web/site.h"

namespace zebtell::web {

// One browser's session. Requests hold it while they run, so that it may leave the store at any
// time; its instance ends with the last of them.
class Session {
  public:
    Session(std::string session_id, std::shared_ptr<SerialQueue> queue)
        : session_id(std::move(session_id)), queue(std::move(queue)) {}

    const std::string session_id;  // for the log; not the cookie's token
    const std::shared_ptr<SerialQueue> queue;
    std::unique_ptr<SessionInstance> instance;  // only for tasks of the queue; null: make one

  private:
    friend class SessionStore;
    TokenKey key_;  // guarded by the store
};

// The sessions by their tokens. Thread-safe; sessions that leave are destroyed by the caller, never
// under the lock.
class SessionStore {
  public:
    using Clock = std::function<std::chrono::steady_clock::time_point()>;

    struct Options {
        std::chrono::minutes idle{20};
        std::size_t max_sessions = 10'000;
        std::size_t queue_limit = 32;
        Clock clock = std::chrono::steady_clock::now;
    };

    struct Created {
        std::shared_ptr<Session> session;
        std::string token;
        std::shared_ptr<Session> evicted;  // had to go; null: none
    };

    struct Counts {
        std::size_t all = 0;
        std::size_t logged_on = 0;
    };

    SessionStore(WorkerPool& pool, Options options);

    // Null for a token that is unknown or whose session has been idle for too long. Counts as use.
    std::shared_ptr<Session> Find(std::string_view token);
    // When the store is full, the session that has been idle longest goes, guests only when nobody
    // is anonymous, users and those with requests under way never; nothing when there are no
    // others.
    std::optional<Created> Create();

    // A request of the session has ended.
    void Touch(const Session& session, Standing standing);
    // The session's new token; the old one is unknown from now on. Nothing when the session has
    // left.
    std::optional<std::string> RenewToken(Session& session);

    // Takes out the sessions that have been idle for too long.
    std::vector<std::shared_ptr<Session>> TakeExpired();
    std::vector<std::shared_ptr<Session>> TakeAll();
    Counts Count() const;

  private:
    struct Entry {
        std::shared_ptr<Session> session;
        std::chrono::steady_clock::time_point last_used;
        Standing standing = Standing::kAnonymous;
    };
    using Entries = std::list<Entry>;  // the longest idle first

    Entries& ListOf(Standing standing) { return entries_[static_cast<std::size_t>(standing)]; }
    void Use(Entries::iterator entry, Standing standing);
    std::shared_ptr<Session> MakeRoom();
    std::shared_ptr<Session> Remove(Entries::iterator entry);
    bool IsExpired(const Entry& entry) const;

    WorkerPool& pool_;
    const Options options_;
    mutable std::mutex mutex_;
    std::array<Entries, 3> entries_;  // by standing
    std::unordered_map<TokenKey, Entries::iterator, TokenKeyHash> by_key_;
    std::uint32_t next_number_ = FirstSessionNumber();
};

}  // namespace zebtell::web
