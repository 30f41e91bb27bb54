#pragma once

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <charconv>
#include <chrono>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/text.h"

namespace zebtell::testing {

struct RawResponse {
    int status = 0;
    std::vector<std::pair<std::string, std::string>> headers;
    std::string body;

    // The first header of that name, "" when there is none.
    std::string Header(std::string_view name) const {
        for (const auto& [header, value] : headers) {
            if (base::EqualNoCase(header, name)) return value;
        }
        return {};
    }
};

// A client that sends exactly the bytes it is told to. Whatever takes longer than the time limit,
// or ends too early, is a std::runtime_error.
class RawClient {
  public:
    // To this machine, where the whole network 127.0.0.0/8 is; `from` one of its addresses, or null
    // for the usual one.
    explicit RawClient(std::uint16_t port, const char* from = nullptr)
        : fd_(::socket(AF_INET, SOCK_STREAM, 0)) {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        if (from != nullptr) inet_pton(AF_INET, from, &address.sin_addr);
        if (from != nullptr &&
            ::bind(fd_, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
            ::close(fd_);
            throw std::runtime_error("cannot bind");
        }
        address.sin_family = AF_INET;
        address.sin_port = htons(port);
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        if (::connect(fd_, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
            ::close(fd_);
            throw std::runtime_error("cannot connect");
        }
    }
    ~RawClient() { Close(); }
    RawClient(const RawClient&) = delete;
    RawClient& operator=(const RawClient&) = delete;

    void set_time_limit(std::chrono::milliseconds limit) { limit_ = limit; }
    int fd() const { return fd_; }

    void Send(std::string_view bytes) {
        while (!bytes.empty()) {
            const auto sent = ::send(fd_, bytes.data(), bytes.size(), MSG_NOSIGNAL);
            if (sent <= 0) throw std::runtime_error("cannot send");
            bytes.remove_prefix(static_cast<std::size_t>(sent));
        }
    }
    void EndSending() { ::shutdown(fd_, SHUT_WR); }
    void Close() {
        if (fd_ >= 0) ::close(std::exchange(fd_, -1));
    }

    // The next response. One to a HEAD request has no body, whatever its Content-Length says.
    RawResponse Read(bool to_head = false) {
        RawResponse response = ReadHead();
        if (!to_head) response.body = Take(BodySize(response));
        return response;
    }
    RawResponse Ask(std::string_view bytes) {
        Send(bytes);
        return Read();
    }

    // All that comes until nothing does for that long, or the server closes.
    std::string ReadUntilQuiet(std::chrono::milliseconds time) {
        pollfd poll{fd_, POLLIN, 0};
        while (::poll(&poll, 1, static_cast<int>(time.count())) == 1 && Receive()) {
        }
        return std::exchange(received_, {});
    }

    // Whether the server ends the connection, without a further byte, within the time limit.
    bool IsClosed() { return received_.empty() && !Receive(); }

  private:
    RawResponse ReadHead() {
        std::size_t end;
        while ((end = received_.find("\r\n\r\n")) == std::string::npos) MustReceive();
        const std::string head = Take(end + 4);
        RawResponse response;
        std::from_chars(head.data() + 9, head.data() + head.size(), response.status);
        for (std::size_t at = head.find("\r\n") + 2; at < end;) {
            const std::size_t line_end = head.find("\r\n", at);
            const std::size_t colon = head.find(": ", at);
            response.headers.emplace_back(head.substr(at, colon - at),
                                          head.substr(colon + 2, line_end - colon - 2));
            at = line_end + 2;
        }
        return response;
    }

    static std::size_t BodySize(const RawResponse& response) {
        const std::string length = response.Header("Content-Length");
        return length.empty() ? 0 : std::stoul(length);
    }

    std::string Take(std::size_t count) {
        while (received_.size() < count) MustReceive();
        std::string taken = received_.substr(0, count);
        received_.erase(0, count);
        return taken;
    }

    void MustReceive() {
        if (!Receive()) throw std::runtime_error("closed early, after: " + received_);
    }

    // False when the server has closed.
    bool Receive() {
        pollfd poll{fd_, POLLIN, 0};
        if (::poll(&poll, 1, static_cast<int>(limit_.count())) != 1) {
            throw std::runtime_error("nothing within the time limit, after: " + received_);
        }
        char bytes[16 * 1024];
        const auto count = ::recv(fd_, bytes, sizeof bytes, 0);
        if (count <= 0) return false;
        received_.append(bytes, static_cast<std::size_t>(count));
        return true;
    }

    int fd_;
    std::chrono::milliseconds limit_{5000};
    std::string received_;
};

}  // namespace zebtell::testing
