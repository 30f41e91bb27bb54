#pragma once

#include <gtest/gtest.h>

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "http/server.h"
#include "tests/support/raw_client.h"

namespace zebtell::http {

using zebtell::testing::RawClient;
using zebtell::testing::RawResponse;

inline ServerOptions TwoThreads() {
    ServerOptions options;
    options.io_threads = 2;
    return options;
}

// "GET|/path?query|body" of whatever is asked.
inline void Echo(const Request& request, const Responder& respond) {
    Response response;
    response.body = request.method + "|" + request.target + "|" + request.body;
    respond(std::move(response));
}

// Keeps the responders of its requests until a test wants them answered.
class Held {
  public:
    Handler handler() {
        return [this](const Request&, Responder respond) { Push(std::move(respond)); };
    }
    Responder Take() {
        std::unique_lock lock(mutex_);
        EXPECT_TRUE(
            came_.wait_for(lock, std::chrono::seconds(5), [this] { return !responders_.empty(); }));
        Responder first = std::move(responders_.front());
        responders_.erase(responders_.begin());
        return first;
    }

  private:
    void Push(Responder respond) {
        const std::lock_guard lock(mutex_);
        responders_.push_back(std::move(respond));
        came_.notify_all();
    }

    std::mutex mutex_;
    std::condition_variable came_;
    std::vector<Responder> responders_;
};

// A started server on a free port.
struct TestServer {
    explicit TestServer(Handler handler = Echo, ServerOptions options = TwoThreads())
        : server(std::move(options), std::move(handler)) {
        server.Start();
    }
    Server server;
    RawClient Connect() const { return RawClient(server.port()); }
};

inline std::string Get(const std::string& target, const std::string& headers = "") {
    return "GET " + target + " HTTP/1.1\r\nHost: shop\r\n" + headers + "\r\n";
}

inline std::string Post(const std::string& target, const std::string& body) {
    return "POST " + target +
           " HTTP/1.1\r\nHost: shop\r\nContent-Length: " + std::to_string(body.size()) +
           "\r\n\r\n" + body;
}

}  // namespace zebtell::http
