#pragma once

#include <cstddef>
#include <span>
#include <string_view>
#include <vector>

namespace zebtell::http {

// The bytes of a connection that have come and were not taken yet, in one piece.
class ReadBuffer {
  public:
    std::string_view Data() const { return {bytes_.data() + begin_, end_ - begin_}; }
    void Consume(std::size_t count);

    // At least `wanted` free bytes behind the data, to be filled from the front.
    std::span<char> Space(std::size_t wanted);
    void Commit(std::size_t count) { end_ += count; }

    std::size_t Capacity() const { return bytes_.size(); }
    void Clear() { begin_ = end_ = 0; }
    // An idle connection keeps no more than this.
    void ShrinkWhenEmpty();

    static constexpr std::size_t kIdleSize = 4096;

  private:
    std::vector<char> bytes_ = std::vector<char>(kIdleSize);
    std::size_t begin_ = 0;
    std::size_t end_ = 0;
};

}  // namespace zebtell::http
