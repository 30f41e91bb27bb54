#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace zebtell::web {

// 128 random bits as 32 hexadecimal digits: the only proof that a browser owns a session.
std::string NewSessionToken();

// A random number for the first SessionID of the process: 9 digits, room to count up.
std::uint32_t FirstSessionNumber();

// What the store knows a token by: its hash under a key that each process makes anew. How long a
// look-up takes says nothing about the tokens that exist.
struct TokenKey {
    std::array<std::uint8_t, 16> bytes{};

    static TokenKey Of(std::string_view token);
    friend bool operator==(const TokenKey&, const TokenKey&) = default;
};

struct TokenKeyHash {
    std::size_t operator()(const TokenKey& key) const;
};

}  // namespace zebtell::web
