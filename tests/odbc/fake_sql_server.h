#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <string>
#include <thread>

namespace zebtell::erp {

// What a server that speaks SQL Server's protocol answers. As much of the protocol as it takes to
// see what a driver sends, and to answer with errors, silence and lost connections.
class FakeSqlServer {
  public:
    struct Answer {
        enum class Kind { kDone, kInteger, kError, kSilence, kHangUp, kGarbage };
        Kind kind = Kind::kDone;
        std::int32_t number = 0;  // the integer, or the error's number
        std::string text = {};
    };
    // Gets "" for the log-on, else what the client sends, whole, with all bytes but printable ASCII
    // left out.
    using Script = std::function<Answer(const std::string& request)>;

    explicit FakeSqlServer(Script script);
    ~FakeSqlServer();
    FakeSqlServer(const FakeSqlServer&) = delete;
    FakeSqlServer& operator=(const FakeSqlServer&) = delete;

    // With the portal's own user.
    std::string connection_string() const;
    int connections() const { return connections_; }

  private:
    void Accept();
    void Serve(int client);
    bool Reply(int client, char type, const std::string& message);

    Script script_;
    int listener_;
    std::uint16_t port_ = 0;
    std::atomic<int> connections_ = 0;
    std::atomic<bool> stopping_ = false;
    std::thread thread_;
};

}  // namespace zebtell::erp
