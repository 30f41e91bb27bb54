#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::data {

// Text that a person typed, on its way into a filter.
struct Typed {
    std::string_view text;
};

// A filter as it is written, with marks on what people typed. Typed text stands in it without any
// escaping, and the runtime lets it be no more than a value: between quotes it is text, its own
// quotes included, and elsewhere nothing but whole numbers and commas. So nobody types a condition.
class Filter {
  public:
    // The places of typed text in the filter.
    struct Span {
        std::size_t begin;
        std::size_t end;

        friend bool operator==(const Span&, const Span&) = default;
    };

    Filter() = default;
    Filter(const char* text) : text_(text) {}
    Filter(std::string_view text) : text_(text) {}
    Filter(std::string text) : text_(std::move(text)) {}
    Filter(Typed typed) : text_(typed.text), typed_{{0, text_.size()}} {}

    Filter& operator+=(const Filter& more);
    friend Filter operator+(Filter left, const Filter& right) { return std::move(left += right); }

    bool empty() const { return text_.empty(); }
    const std::string& text() const { return text_; }
    std::span<const Span> typed() const { return typed_; }

  private:
    std::string text_;
    std::vector<Span> typed_;  // in their order
};

}  // namespace zebtell::data
