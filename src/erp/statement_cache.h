#pragma once

#include <functional>
#include <list>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>

namespace zebtell::erp {

// The prepared statements of one connection, kept for their next use; those unused longest go
// first. `Statement` has a Reset, which leaves it ready for other values.
template <class Statement>
class StatementCache {
  public:
    using Prepare = std::function<std::unique_ptr<Statement>(const std::string&)>;

    explicit StatementCache(Prepare prepare) : prepare_(std::move(prepare)) {}

    // Takes the statement out, so that a nested use of the same text makes another one.
    std::unique_ptr<Statement> Take(const std::string& text) {
        const auto found = by_text_.find(text);
        if (found == by_text_.end()) {
            return prepare_(text);
        }
        const auto kept = found->second;
        auto statement = std::move(kept->statement);
        by_text_.erase(found);
        kept_.erase(kept);
        return statement;
    }

    void Give(const std::string& text, std::unique_ptr<Statement> statement) {
        statement->Reset();
        if (by_text_.contains(text)) {
            return;
        }
        kept_.push_front({text, std::move(statement)});
        by_text_.emplace(kept_.front().text, kept_.begin());
        if (kept_.size() > kMost) {
            by_text_.erase(kept_.back().text);
            kept_.pop_back();
        }
    }

  private:
    static constexpr std::size_t kMost = 64;

    struct Kept {
        std::string text;
        std::unique_ptr<Statement> statement;
    };

    Prepare prepare_;
    std::list<Kept> kept_;  // the one used last first
    std::unordered_map<std::string_view, typename std::list<Kept>::iterator> by_text_;
};

}  // namespace zebtell::erp
