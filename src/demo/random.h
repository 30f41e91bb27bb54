#pragma once

#include <cstdint>
#include <iterator>

namespace zebtell::demo {

// A small random generator of its own (SplitMix64), since those of the standard library's
// distributions differ from one library to another and the demo data must not. For the same
// reason no expression draws two numbers, unless their order is certain.
class Random {
  public:
    explicit Random(std::uint64_t seed) : state_(seed) {}

    std::uint64_t Next() {
        std::uint64_t mixed = state_ += 0x9E3779B97F4A7C15U;
        mixed = (mixed ^ (mixed >> 30U)) * 0xBF58476D1CE4E5B9U;
        mixed = (mixed ^ (mixed >> 27U)) * 0x94D049BB133111EBU;
        return mixed ^ (mixed >> 31U);
    }
    // 0 to count-1; count is at least 1.
    int Below(int count) { return static_cast<int>((Next() >> 32U) * Unsigned(count) >> 32U); }
    int Between(int first, int last) { return first + Below(last - first + 1); }
    bool Percent(int chance) { return Below(100) < chance; }
    template <class Choices>
    const auto& Pick(const Choices& choices) {
        return choices[Unsigned(Below(static_cast<int>(std::size(choices))))];
    }

  private:
    static constexpr std::uint64_t Unsigned(int number) {
        return static_cast<std::uint64_t>(number);
    }

    std::uint64_t state_;
};

}  // namespace zebtell::demo
