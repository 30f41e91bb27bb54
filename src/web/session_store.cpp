#include "web/session_store.h"

#include <algorithm>
#include <utility>

namespace zebtell::web {

SessionStore::SessionStore(WorkerPool& pool, Options options)
    : pool_(pool), options_(std::move(options)) {}

std::shared_ptr<Session> SessionStore::Find(std::string_view token) {
    const TokenKey key = TokenKey::Of(token);
    std::shared_ptr<Session> expired;  // is destroyed after the lock
    const std::lock_guard lock(mutex_);
    const auto found = by_key_.find(key);
    if (found == by_key_.end()) return nullptr;
    const auto entry = found->second;
    if (IsExpired(*entry)) {
        expired = Remove(entry);
        return nullptr;
    }
    Use(entry, entry->standing);
    return entry->session;
}

std::optional<SessionStore::Created> SessionStore::Create() {
    Created created;
    created.token = NewSessionToken();
    auto queue = std::make_shared<SerialQueue>(pool_, options_.queue_limit);
    const std::lock_guard lock(mutex_);
    if (by_key_.size() >= options_.max_sessions) {
        created.evicted = MakeRoom();
        if (created.evicted == nullptr) return std::nullopt;
    }
    created.session = std::make_shared<Session>(std::to_string(next_number_++), std::move(queue));
    created.session->key_ = TokenKey::Of(created.token);
    Entries& anonymous = ListOf(Standing::kAnonymous);
    const auto entry = anonymous.insert(anonymous.end(), {created.session, options_.clock()});
    by_key_.emplace(created.session->key_, entry);
    return created;
}

std::shared_ptr<Session> SessionStore::MakeRoom() {
    for (Entries& entries : entries_) {
        if (!entries.empty() && IsExpired(entries.front())) return Remove(entries.begin());
    }
    // Who has a request under way, such as a log-on that waits for its turn, holds the session too.
    const auto is_unused = [](const Entry& entry) { return entry.session.use_count() == 1; };
    for (const Standing standing : {Standing::kAnonymous, Standing::kGuest}) {
        Entries& entries = ListOf(standing);
        const auto found = std::find_if(entries.begin(), entries.end(), is_unused);
        if (found != entries.end()) return Remove(found);
    }
    return nullptr;
}

void SessionStore::Touch(const Session& session, Standing standing) {
    const std::lock_guard lock(mutex_);
    const auto found = by_key_.find(session.key_);
    if (found != by_key_.end()) Use(found->second, standing);
}

std::optional<std::string> SessionStore::RenewToken(Session& session) {
    std::string token = NewSessionToken();
    const std::lock_guard lock(mutex_);
    auto node = by_key_.extract(session.key_);
    if (node.empty()) return std::nullopt;
    node.key() = session.key_ = TokenKey::Of(token);
    by_key_.insert(std::move(node));
    return token;
}

std::vector<std::shared_ptr<Session>> SessionStore::TakeExpired() {
    std::vector<std::shared_ptr<Session>> taken;
    const std::lock_guard lock(mutex_);
    for (Entries& entries : entries_) {
        while (!entries.empty() && IsExpired(entries.front()))
            taken.push_back(Remove(entries.begin()));
    }
    return taken;
}

std::vector<std::shared_ptr<Session>> SessionStore::TakeAll() {
    std::vector<std::shared_ptr<Session>> taken;
    const std::lock_guard lock(mutex_);
    for (Entries& entries : entries_)
        while (!entries.empty()) taken.push_back(Remove(entries.begin()));
    return taken;
}

SessionStore::Counts SessionStore::Count() const {
    const std::lock_guard lock(mutex_);
    return {by_key_.size(), by_key_.size() - entries_.front().size()};
}

void SessionStore::Use(Entries::iterator entry, Standing standing) {
    Entries& from = ListOf(entry->standing);
    Entries& to = ListOf(standing);
    entry->last_used = options_.clock();
    entry->standing = standing;
    to.splice(to.end(), from, entry);
}

std::shared_ptr<Session> SessionStore::Remove(Entries::iterator entry) {
    std::shared_ptr<Session> session = std::move(entry->session);
    by_key_.erase(session->key_);
    ListOf(entry->standing).erase(entry);
    return session;
}

bool SessionStore::IsExpired(const Entry& entry) const {
    return options_.clock() - entry.last_used > options_.idle;
}

}  // namespace zebtell::web
