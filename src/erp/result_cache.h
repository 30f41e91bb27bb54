#pragma once

#include <cstddef>
#include <cstdint>
#include <list>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>
#include <unordered_map>

#include "erp/bound_sql.h"

namespace zebtell::erp {

// What a statement gave: a list's keys, a window of rows, a query's result. Never changes.
class Result {
  public:
    virtual ~Result() = default;
    virtual std::size_t Bytes() const = 0;
};

// Results that all sessions share, for as long as the database has not changed since they were
// read. Those unused longest go first when there are too many. Thread-safe.
class ResultCache {
  public:
    explicit ResultCache(std::size_t limit_bytes) : limit_(limit_bytes) {}

    // `version` is the database's, read before: null when there is no result of that version.
    std::shared_ptr<const Result> Find(const std::string& key, std::int64_t version);
    // `version` is the database's, read before the statement ran.
    void Keep(const std::string& key, std::int64_t version, std::shared_ptr<const Result> result);

    std::size_t bytes() const;

  private:
    struct Kept {
        std::string key;
        std::shared_ptr<const Result> result;
        std::size_t bytes;
    };

    void MoveTo(std::int64_t version);
    void Shrink();

    mutable std::mutex mutex_;
    std::size_t limit_;
    std::size_t bytes_ = 0;
    std::int64_t version_ = 0;  // of all that is kept
    std::list<Kept> kept_;      // the one used last first
    std::unordered_map<std::string_view, std::list<Kept>::iterator> by_key_;
};

// The key of a statement: its text and values.
std::string ResultKey(char kind, const BoundSql& sql);

}  // namespace zebtell::erp
