#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace zebtell::base {

// For tables of short names that a page looks up by the hundred: of the length and the last eight
// bytes, where names of tags and fields differ. Names that are equal but for case have one hash.
inline std::size_t NameHash(std::string_view name) {
    constexpr std::uint64_t kSmallLetters = 0x2020202020202020U;
    constexpr std::uint64_t kBeyondAscii = 0x8080808080808080U;
    std::uint64_t end = 0;
    if (name.size() >= sizeof(end)) {
        std::memcpy(&end, name.data() + name.size() - sizeof(end), sizeof(end));
    } else {
        std::memcpy(&end, name.data(), name.size());
    }
    end = (end & kBeyondAscii) != 0 ? 0 : end | kSmallLetters;
    const std::uint64_t mixed = (end + name.size()) * 0x9E3779B97F4A7C15U;
    return static_cast<std::size_t>(mixed >> 32);
}

}  // namespace zebtell::base
