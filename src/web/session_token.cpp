#include "web/session_token.h"

#include <sodium.h>

#include <cstring>
#include <stdexcept>

namespace zebtell::web {
namespace {

constexpr std::size_t kTokenBytes = 16;

void RequireSodium() {
    // Does nothing after its first call; threads may call it at once.
    if (sodium_init() < 0) throw std::runtime_error("libsodium can't be initialised");
}

using HashKey = std::array<unsigned char, crypto_shorthash_siphashx24_KEYBYTES>;

const HashKey& ProcessKey() {
    static const HashKey key = [] {
        RequireSodium();
        HashKey made;
        randombytes_buf(made.data(), made.size());
        return made;
    }();
    return key;
}

}  // namespace

std::string NewSessionToken() {
    RequireSodium();
    std::array<unsigned char, kTokenBytes> bytes;
    randombytes_buf(bytes.data(), bytes.size());
    std::array<char, 2 * kTokenBytes + 1> hex;
    return sodium_bin2hex(hex.data(), hex.size(), bytes.data(), bytes.size());
}

std::uint32_t FirstSessionNumber() {
    RequireSodium();
    return 100'000'000 + randombytes_uniform(800'000'000);
}

TokenKey TokenKey::Of(std::string_view token) {
    TokenKey key;
    static_assert(sizeof(key.bytes) == crypto_shorthash_siphashx24_BYTES);
    crypto_shorthash_siphashx24(key.bytes.data(),
                                reinterpret_cast<const unsigned char*>(token.data()),
                                token.size(),
                                ProcessKey().data());
    return key;
}

std::size_t TokenKeyHash::operator()(const TokenKey& key) const {
    std::size_t hash = 0;
    std::memcpy(&hash, key.bytes.data(), sizeof(hash));
    return hash;
}

}  // namespace zebtell::web
