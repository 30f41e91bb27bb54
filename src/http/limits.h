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
    std::size_t requests_per_connection = 1000;
    std::size_t connections = 20'000;
    std::size_t connections_per_address = 0;  // 0: no limit; trusted proxies have none
};

struct Timeouts {
    using Duration = std::chrono::milliseconds;
    Duration head = std::chrono::seconds(10);   // from a request's first byte to its last header
    Duration body = std::chrono::seconds(20);   // from its last header to its end
    Duration idle = std::chrono::seconds(60);   // between requests
    Duration write = std::chrono::seconds(30);  // for a response, and a second more for each 16 KB
    Duration linger = std::chrono::seconds(2);  // for the client to close after the last response
    Duration stop = std::chrono::seconds(5);    // for running requests when the server stops
};

}  // namespace zebtell::http
