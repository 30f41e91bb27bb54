#include "data/filter.h"

namespace zebtell::data {

Filter& Filter::operator+=(const Filter& more) {
    const std::size_t shift = text_.size();
    for (const Span& span : more.typed_) {
        typed_.push_back({span.begin + shift, span.end + shift});
    }
    text_ += more.text_;
    return *this;
}

}  // namespace zebtell::data
