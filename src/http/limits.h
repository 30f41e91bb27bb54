#pragma once

#include <chrono>
#include <cstddef>

namespace zebtell::http {

// What a client may send and hold. A request beyond them is refused, not cut.
struct Limits {
    std::size_t request_line_bytes = std::size_t{8} * 1024;
    std::size_t header_bytes =
        std::size_t{16} * 1024;  // all headers of a request, without the request line
    std::size_t header_count = 100;
    std::size_t body_bytes = std::size_t{1024} * 1024;
    // Of all connections together, the first 16 KB of each not counted.
    std::size_t body_bytes_in_all = std::size_t{64} * 1024 * 1024;
    std::size_t requests_per_connection = 1000;
    std::size_t connections = 20'000;
    std::size_t connections_per_address = 0;  // 0: no limit; trusted proxies have none
};

struct Timeouts {
    using Duration = std::chrono::milliseconds;
    // From a request's first byte to its last header, and from there to its end. Deadlines are
    // looked after now and then, and who is cut off may linger: gone after 10 and 20 s.
    Duration head = std::chrono::seconds(7);
    Duration body = std::chrono::seconds(17);
    Duration idle = std::chrono::seconds(60);         // between requests
    Duration crowded_idle = std::chrono::seconds(5);  // the same with few places left
    Duration write = std::chrono::seconds(30);  // for a response, and a second more for each 16 KB
    Duration linger = std::chrono::seconds(2);  // for the client to close after the last response
    Duration stop = std::chrono::seconds(5);    // for running requests when the server stops
};

}  // namespace zebtell::http
