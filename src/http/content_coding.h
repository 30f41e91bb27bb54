#pragma once

#include <string>
#include <string_view>

namespace zebtell::http {

// How a body is packed for its way.
enum class Coding { kIdentity, kGzip, kBrotli };

// kQuick for what is sent once, kBest for what is kept.
enum class Effort { kQuick, kBest };

// What to send to a client with this Accept-Encoding header: of what it accepts, the coding that it
// likes best. Where it likes both the same, gzip, which is quicker, for what is sent once, and
// brotli, which is shorter, for what is kept.
Coding BestCoding(std::string_view accept_encoding, Effort effort);

// "gzip"; "" for kIdentity.
std::string_view CodingName(Coding coding);

std::string Encoded(std::string_view text, Coding coding, Effort effort);

// Shorter bodies fit into a packet or two as they are.
inline constexpr std::size_t kLeastWorthCoding = 1400;

}  // namespace zebtell::http
