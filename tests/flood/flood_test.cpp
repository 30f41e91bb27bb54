#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/resource.h>

#include <algorithm>
#include <atomic>
#include <memory>
#include <optional>
#include <thread>

#include "tests/portal/browser.h"
#include "tests/support/portal_process.h"

namespace zebtell {
namespace {

using testing::PortalProcess;
using testing::RawClient;
using Clock = std::chrono::steady_clock;
using std::chrono::milliseconds;
using std::chrono::seconds;

constexpr std::size_t kIdle = 10'000;
constexpr std::size_t kSlowOfAKind = 200;  // that send headers, and that send bodies
constexpr int kStrangers = 50'000;
constexpr std::size_t kMostGrowth = std::size_t{64} * 1024 * 1024;
constexpr milliseconds kPatience(100);

const std::string kLogonPage = "GET /?page=Logon HTTP/1.1\r\nHost: a\r\n";
const std::string kSlowHead = "GET /?page=Logon HTTP/1.1\r\nX: ";
const std::string kSlowBody =
    "POST /?page=Logon&event=Logon HTTP/1.1\r\nHost: a\r\nContent-Length: 1000\r\n"
    "Content-Type: application/x-www-form-urlencoded\r\n\r\n";

void RaiseFileLimit(rlim_t wanted) {
    rlimit files{};
    ASSERT_EQ(getrlimit(RLIMIT_NOFILE, &files), 0);
    files.rlim_cur = std::max(files.rlim_cur, wanted);
    files.rlim_max = std::max(files.rlim_max, wanted);
    ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &files), 0)
        << "this test needs " << wanted << " open files: raise the limit (ulimit -Hn)";
}

class Flood : public ::testing::Test {
  protected:
    void SetUp() override {
        RaiseFileLimit(kIdle + 2 * kSlowOfAKind + 1000);
        portal.emplace(ZEBTELL_PROGRAM);
    }

    std::optional<PortalProcess> portal;
};

template <class Work>
milliseconds Timed(Work&& work) {
    const auto begin = Clock::now();
    work();
    return std::chrono::ceil<milliseconds>(Clock::now() - begin);
}

milliseconds Percentile95(std::vector<milliseconds> times) {
    std::sort(times.begin(), times.end());
    return times.at(times.size() * 95 / 100);
}

// Connections that send a byte now and then until the portal has had enough.
class SlowClients {
  public:
    SlowClients(std::uint16_t port, const std::string& at_once) : begin_(Clock::now()) {
        for (std::size_t i = 0; i < kSlowOfAKind; ++i) {
            clients_.push_back(std::make_unique<RawClient>(port));
            clients_.back()->Send(at_once);
        }
    }

    void Trickle() {
        for (auto& client : clients_) {
            if (client == nullptr) continue;
            ::send(client->fd(), "x", 1, MSG_NOSIGNAL);
            char bytes[4096];
            ssize_t count = 0;
            do count = ::recv(client->fd(), bytes, sizeof bytes, MSG_DONTWAIT);
            while (count > 0);
            if (count < 0 && errno == EAGAIN) continue;
            client.reset();
            last_end_ = Clock::now();
        }
    }
    bool HaveEnded() const {
        return std::none_of(
            clients_.begin(), clients_.end(), [](const auto& each) { return each != nullptr; });
    }
    milliseconds Lasted() const { return std::chrono::ceil<milliseconds>(last_end_ - begin_); }

  private:
    const Clock::time_point begin_;
    std::vector<std::unique_ptr<RawClient>> clients_;
    Clock::time_point last_end_;
};

TEST_F(Flood, IdleAndSlowConnectionsHoldNobodyUp) {
    std::vector<std::unique_ptr<RawClient>> idle;
    for (std::size_t i = 0; i < kIdle; ++i) {
        idle.push_back(std::make_unique<RawClient>(portal->port()));
        idle.back()->Send("HEAD /static/zebtell.svg HTTP/1.1\r\nHost: a\r\n\r\n");
        ASSERT_EQ(idle.back()->Read(true).status, 200) << i;
    }
    SlowClients heads(portal->port(), kSlowHead);
    SlowClients bodies(portal->port(), kSlowBody);
    std::vector<milliseconds> times;
    const auto limit = Clock::now() + seconds(25);
    while (!(heads.HaveEnded() && bodies.HaveEnded()) && Clock::now() < limit) {
        for (int i = 0; i < 5; ++i) {
            times.push_back(Timed([&] {
                RawClient client(portal->port());
                ASSERT_EQ(client.Ask(kLogonPage + "\r\n").status, 200);
            }));
            std::this_thread::sleep_for(milliseconds(20));
        }
        heads.Trickle();
        bodies.Trickle();
    }
    EXPECT_TRUE(heads.HaveEnded() && bodies.HaveEnded());
    EXPECT_LE(heads.Lasted(), seconds(10));
    EXPECT_LE(bodies.Lasted(), seconds(20));
    EXPECT_LE(Percentile95(times), kPatience);
    for (const auto& client : idle) {
        char byte;
        ASSERT_TRUE(::recv(client->fd(), &byte, 1, MSG_DONTWAIT) < 0 && errno == EAGAIN)
            << "an idle connection was closed: the test was shorter than their time";
    }
    std::cout << "log-on page, 95 of 100: " << Percentile95(times).count() << " ms of "
              << times.size() << "; slow headers " << heads.Lasted().count() << " ms, bodies "
              << bodies.Lasted().count() << " ms\n";
}

TEST_F(Flood, LogOnsHoldNobodyUpWhoIsLoggedOn) {
    Browser customer(portal->port());
    customer.LogOn("klient20", "klient-demo");
    std::atomic<bool> is_over = false;
    std::atomic<int> refused = 0, turned_away = 0, impatient = 0;
    std::vector<std::jthread> guessers;
    for (int i = 0; i < 40; ++i) {
        guessers.emplace_back([&, i] {
            for (int round = 0; !is_over; ++round) {
                Browser guesser(portal->port());
                const std::string name = "guess" + std::to_string(100 * round + i);
                try {
                    const auto answer =
                        guesser.Ask("/?page=Logon&event=Logon",
                                    "POST",
                                    Browser::Encoded({{"ZEB_IN_KASUTAJATUNNUS", name},
                                                      {"ZEB_IN_PAROOL", "wrong"}}));
                    ++(answer.status == 503 ? turned_away : refused);
                } catch (const std::runtime_error&) {
                    ++impatient;  // where log-ons take longer than a client waits
                }
            }
        });
    }
    std::vector<milliseconds> times;
    for (int i = 0; i < 100; ++i) {
        times.push_back(Timed([&] { customer.Get("Kaubainfo"); }));
        EXPECT_THAT(customer.page(), ::testing::HasSubstr("page=Logout"));
        std::this_thread::sleep_for(milliseconds(20));
    }
    is_over = true;
    guessers.clear();
    EXPECT_GT(refused, 20) << "there was no flood";
    EXPECT_LE(Percentile95(times), kPatience);
    std::cout << "catalogue, 95 of 100: " << Percentile95(times).count() << " ms beside " << refused
              << " log-ons, " << turned_away << " turned away, " << impatient
              << " tired of waiting\n";
}

TEST_F(Flood, StrangersCostLittleAndPushNobodyOut) {
    constexpr int kAtOnce = 50;
    Browser customer(portal->port());
    customer.LogOn("klient21", "klient-demo");
    const std::size_t before = portal->ResidentBytes();
    std::string requests;
    for (int i = 0; i < kAtOnce; ++i) requests += kLogonPage + "\r\n";
    for (int sent = 0; sent < kStrangers; sent += kAtOnce) {
        RawClient stranger(portal->port());
        stranger.Send(requests);
        for (int i = 0; i < kAtOnce; ++i) ASSERT_EQ(stranger.Read().status, 200) << sent + i;
    }
    const std::size_t after = portal->ResidentBytes();
    EXPECT_LT(after, before + kMostGrowth);
    customer.Get("Kaubainfo");
    EXPECT_THAT(customer.page(), ::testing::HasSubstr("page=Logout"));
    std::cout << kStrangers
              << " requests without a cookie: " << (after > before ? after - before : 0) / 1024
              << " KiB\n";
}

}  // namespace
}  // namespace zebtell
