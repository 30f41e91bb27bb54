#pragma once

#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
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
    std::size_t PlaceOf(std::string_view lower_name) const;

    std::vector<TagRow> rows_;
    std::vector<std::string> lower_names_;  // of the rows
    std::vector<std::size_t> places_;       // open addressing: the row plus 1, 0 for free places
    std::vector<std::pair<std::string, std::size_t>> patterns_;  // in lower case
};

}  // namespace zebtell::tags
