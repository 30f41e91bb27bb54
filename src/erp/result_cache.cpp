#include "erp/result_cache.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kOverhead = 200;  // of an entry's own nodes

}  // namespace

std::shared_ptr<const Result> ResultCache::Find(const std::string& key, std::int64_t version) {
    std::lock_guard lock(mutex_);
    MoveTo(version);
    const auto found = by_key_.find(key);
    if (version != version_ || found == by_key_.end()) {
        return nullptr;
    }
    kept_.splice(kept_.begin(), kept_, found->second);
    return found->second->result;
}

void ResultCache::Keep(const std::string& key,
                       std::int64_t version,
                       std::shared_ptr<const Result> result) {
    const std::size_t bytes = result->Bytes() + key.size() + kOverhead;
    std::lock_guard lock(mutex_);
    MoveTo(version);
    if (version != version_ || bytes > limit_ / 2 || by_key_.contains(key)) {
        return;
    }
    kept_.push_front({key, std::move(result), bytes});
    by_key_.emplace(kept_.front().key, kept_.begin());
    bytes_ += bytes;
    Shrink();
}

std::size_t ResultCache::bytes() const {
    std::lock_guard lock(mutex_);
    return bytes_;
}

// Versions only grow; a thread that looked earlier may come later with a smaller one.
void ResultCache::MoveTo(std::int64_t version) {
    if (version > version_) {
        by_key_.clear();
        kept_.clear();
        bytes_ = 0;
        version_ = version;
    }
}

void ResultCache::Shrink() {
    while (bytes_ > limit_) {
        bytes_ -= kept_.back().bytes;
        by_key_.erase(kept_.back().key);
        kept_.pop_back();
    }
}

std::string ResultKey(char kind, const BoundSql& sql) {
    std::string key(1, kind);
    key += sql.text;
    for (const base::Value& value : sql.values) {
        key += '\0';
        key += static_cast<char>('0' + static_cast<int>(value.kind()));
        key += value.ToPlainText();
    }
    return key;
}

}  // namespace zebtell::erp
