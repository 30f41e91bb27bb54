#include "web/session_store.h"

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
    Use(entry, entry->logged_on);
    return entry->session;
}

std::optional<SessionStore::Created> SessionStore::Create() {
    Created created;
    created.token = NewSessionToken();
    auto queue = std::make_shared<SerialQueue>(pool_, options_.queue_limit);
    const std::lock_guard lock(mutex_);
    if (by_key_.size() >= options_.max_sessions) {
        const bool has_expired = !logged_on_.empty() && IsExpired(logged_on_.front());
        Entries& from = ListOf(has_expired);
        if (from.empty()) return std::nullopt;
        created.evicted = Remove(from.begin());
    }
    created.session = std::make_shared<Session>(std::to_string(next_number_++), std::move(queue));
    created.session->key_ = TokenKey::Of(created.token);
    const auto entry =
        anonymous_.insert(anonymous_.end(), {created.session, options_.clock(), false});
    by_key_.emplace(created.session->key_, entry);
    return created;
}

void SessionStore::Touch(const Session& session, bool logged_on) {
    const std::lock_guard lock(mutex_);
    const auto found = by_key_.find(session.key_);
    if (found != by_key_.end()) Use(found->second, logged_on);
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
    for (Entries* entries : {&anonymous_, &logged_on_}) {
        while (!entries->empty() && IsExpired(entries->front()))
            taken.push_back(Remove(entries->begin()));
    }
    return taken;
}

std::vector<std::shared_ptr<Session>> SessionStore::TakeAll() {
    std::vector<std::shared_ptr<Session>> taken;
    const std::lock_guard lock(mutex_);
    for (Entries* entries : {&anonymous_, &logged_on_})
        while (!entries->empty()) taken.push_back(Remove(entries->begin()));
    return taken;
}

SessionStore::Counts SessionStore::Count() const {
    const std::lock_guard lock(mutex_);
    return {by_key_.size(), logged_on_.size()};
}

void SessionStore::Use(Entries::iterator entry, bool logged_on) {
    Entries& from = ListOf(entry->logged_on);
    Entries& to = ListOf(logged_on);
    entry->last_used = options_.clock();
    entry->logged_on = logged_on;
    to.splice(to.end(), from, entry);
}

std::shared_ptr<Session> SessionStore::Remove(Entries::iterator entry) {
    std::shared_ptr<Session> session = std::move(entry->session);
    by_key_.erase(session->key_);
    ListOf(entry->logged_on).erase(entry);
    return session;
}

bool SessionStore::IsExpired(const Entry& entry) const {
    return options_.clock() - entry.last_used > options_.idle;
}

}  // namespace zebtell::web
