#include "http/read_buffer.h"

#include <algorithm>

namespace zebtell::http {

void ReadBuffer::Consume(std::size_t count) {
    begin_ += count;
    if (begin_ == end_) Clear();
}

std::span<char> ReadBuffer::Space(std::size_t wanted) {
    if (bytes_.size() - end_ < wanted && begin_ > 0) {
        std::copy(bytes_.begin() + static_cast<std::ptrdiff_t>(begin_),
                  bytes_.begin() + static_cast<std::ptrdiff_t>(end_),
                  bytes_.begin());
        end_ -= begin_;
        begin_ = 0;
    }
    if (bytes_.size() - end_ < wanted) bytes_.resize(std::max(2 * bytes_.size(), end_ + wanted));
    return std::span(bytes_).subspan(end_);
}

void ReadBuffer::ShrinkWhenEmpty() {
    if (begin_ == end_ && bytes_.size() > kIdleSize) bytes_ = std::vector<char>(kIdleSize);
}

}  // namespace zebtell::http
