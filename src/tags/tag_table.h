#pragma once

#include <cstdint>
#include <functional>
#include <initializer_list>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "host/session_state.h"
#include "markup/tag.h"

namespace zebtell::tags {

// What a tag's function works with.
struct TagCall {
    host::SessionState& state;
    web::Call& call;
    markup::Tag& tag;
    std::string_view page;     // the page's name, or what stands for it in named queries
    std::int32_t row_key = 0;  // for ".Row" lists; 0: the customer's key

    // The text behind `prefix` characters of the tag's name, as the template wrote it.
    std::string_view NameFrom(std::size_t prefix) const { return tag.TagName().substr(prefix); }
};

// Returns Handled: true when no later handler is to look at the tag.
using TagFunction = bool (*)(TagCall&);

struct TagRow {
    std::string_view name;  // "ZEB:Pages.First", or with a "*" at one end a pattern
    TagFunction function;
    std::string_view help;  // one line for the reference page
};

// A handler's tags, tried in the order of the rows: exact names by look-up, then the patterns.
class TagTable {
  public:
    // Throws std::logic_error when a name stands twice.
    TagTable(std::initializer_list<TagRow> rows);

    // Null when no row matches. `lower_name` is in lower case.
    const TagRow* Find(std::string_view lower_name) const;
    // Handled by the row that matches; false when there is none.
    bool Offer(TagCall& call) const;
    const std::vector<TagRow>& rows() const { return rows_; }

  private:
    // Hashes the bytes: names that are asked for are in lower case already.
    struct NameHash {
        using is_transparent = void;
        std::size_t operator()(std::string_view name) const {
            return std::hash<std::string_view>()(name);
        }
    };

    std::vector<TagRow> rows_;
    std::unordered_map<std::string, std::size_t, NameHash, std::equal_to<>> exact_;
    std::vector<std::pair<std::string, std::size_t>> patterns_;  // in lower case
};

}  // namespace zebtell::tags
