#include "erp/password.h"

#include <sodium.h>

#include <algorithm>
#include <semaphore>
#include <thread>

#include "base/runtime_error.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kMemoryBytes = std::size_t{19} * 1024 * 1024;
constexpr unsigned kPasses = 2;

void StartSodium() {
    if (sodium_init() < 0) {
        throw base::RuntimeError(base::errors::kUnspecified, "Passwords can't be checked");
    }
}

// A burst of log-ons must neither take all memory nor starve the pages of others.
class HashTurn {
  public:
    HashTurn() { Turns().acquire(); }
    ~HashTurn() { Turns().release(); }
    HashTurn(const HashTurn&) = delete;
    HashTurn& operator=(const HashTurn&) = delete;

  private:
    static std::counting_semaphore<>& Turns() {
        static std::counting_semaphore<> turns(std::max(1U, std::thread::hardware_concurrency()));
        return turns;
    }
};

const std::string& HashOfNobody() {
    static const std::string hash = HashPassword("nobody has this password");
    return hash;
}

}  // namespace

std::string HashPassword(std::string_view password) {
    StartSodium();
    HashTurn turn;
    char hash[crypto_pwhash_STRBYTES];
    if (crypto_pwhash_str_alg(hash,
                              password.data(),
                              password.size(),
                              kPasses,
                              kMemoryBytes,
                              crypto_pwhash_ALG_ARGON2ID13) != 0) {
        throw base::RuntimeError(base::errors::kUnspecified, "Not enough memory for a password");
    }
    return hash;
}

bool IsPassword(std::string_view password, const std::string& hash) {
    StartSodium();
    const std::string& compared = hash.empty() ? HashOfNobody() : hash;
    HashTurn turn;
    const bool right =
        crypto_pwhash_str_verify(compared.c_str(), password.data(), password.size()) == 0;
    return right && !hash.empty();
}

}  // namespace zebtell::erp
