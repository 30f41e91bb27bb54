#include <gtest/gtest.h>

#include <algorithm>
#include <optional>
#include <thread>

#include "tests/http/test_server.h"

namespace zebtell::http {
namespace {

using std::chrono::milliseconds;
using Clock = std::chrono::steady_clock;

constexpr milliseconds kShort(200);

// Sends a byte every 20 ms until the server answers or closes.
std::optional<RawResponse> Trickle(RawClient& client, const std::string& bytes) {
    client.set_time_limit(milliseconds(20));
    for (const char c : bytes) {
        client.Send(std::string(1, c));
        try {
            return client.Read();
        } catch (const std::runtime_error& error) {
            if (std::string_view(error.what()).starts_with("closed")) return {};
        }
    }
    ADD_FAILURE() << "still open";
    return {};
}

struct TrickleRow {
    const char* label;
    const char* at_once;
    Timeouts::Duration Timeouts::*timeout;
};

// What counts is the time for the whole part, not the time since the last byte.
TEST(SlowClient, IsToldAndClosed) {
    const TrickleRow rows[] = {
        {"head", "GET / HTTP/1.1\r\nX: ", &Timeouts::head},
        {"body", "POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 100\r\n\r\n", &Timeouts::body},
        {"chunk size",
         "POST / HTTP/1.1\r\nHost: a\r\nTransfer-Encoding: chunked\r\n\r\n",
         &Timeouts::body},
    };
    for (const TrickleRow& row : rows) {
        SCOPED_TRACE(row.label);
        ServerOptions options = TwoThreads();
        options.timeouts.*row.timeout = kShort;
        TestServer test(Echo, std::move(options));
        RawClient client = test.Connect();
        const auto begin = Clock::now();
        client.Send(row.at_once);
        const auto response = Trickle(client, std::string(50, '0'));
        ASSERT_TRUE(response);
        EXPECT_EQ(response->status, 408);
        EXPECT_GE(Clock::now() - begin, kShort);
        EXPECT_LT(Clock::now() - begin, 3 * kShort);
    }
}

TEST(SilentClient, IsClosedWithoutAWord) {
    ServerOptions options = TwoThreads();
    options.timeouts.head = 2 * kShort;
    options.timeouts.idle = kShort;
    TestServer test(Echo, std::move(options));
    RawClient fresh = test.Connect();
    RawClient kept = test.Connect();
    RawClient empty_lines = test.Connect();
    EXPECT_EQ(kept.Ask(Get("/")).status, 200);
    EXPECT_FALSE(Trickle(empty_lines,
                         std::string("\r\n\r\n\r\n\r\n\r\n\r\n\r\n\r\n\r\n\r\n\r\n"
                                     "\r\n\r\n\r\n\r\n\r\n\r\n\r\n\r\n\r\n")));
    EXPECT_TRUE(fresh.IsClosed());
    EXPECT_TRUE(kept.IsClosed());
}

TEST(SlowReader, IsClosed) {
    ServerOptions options = TwoThreads();
    options.timeouts.write = kShort;
    const auto large = std::make_shared<const std::string>(std::string(12 * 1024, 'x'));
    TestServer test(
        [&](const Request&, const Responder& respond) {
            Response response;
            response.shared_body = large;
            respond(std::move(response));
        },
        std::move(options));
    RawClient client = test.Connect();
    std::string requests;
    for (int i = 0; i < 2000; ++i) requests += Get("/");
    // Responses fill all buffers, the server stops reading, and in the end it gives up.
    EXPECT_THROW(
        {
            for (int i = 0; i < 1000; ++i) client.Send(requests);
        },
        std::runtime_error);
}

TEST(EarlyRefusal, ReachesAClientThatIsStillSending) {
    TestServer test;
    for (int i = 0; i < 5; ++i) {
        RawClient client = test.Connect();
        client.Send("POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 8000000\r\n\r\n");
        client.Send(std::string(8'000'000, 'x'));
        EXPECT_EQ(client.Read().status, 413);
        EXPECT_TRUE(client.IsClosed());
    }
}

TEST(EarlyRefusal, DrainsOnlyForAMoment) {
    ServerOptions options = TwoThreads();
    options.timeouts.linger = kShort;
    TestServer test(Echo, std::move(options));
    RawClient client = test.Connect();
    EXPECT_EQ(client.Ask("POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 80000000\r\n\r\n").status,
              413);
    const auto begin = Clock::now();
    EXPECT_THROW(
        {
            while (Clock::now() - begin < std::chrono::seconds(5)) client.Send("more");
        },
        std::runtime_error);
    EXPECT_LT(Clock::now() - begin, std::chrono::seconds(2));
}

TEST(Limits, CountRequestsOfAConnection) {
    ServerOptions options = TwoThreads();
    options.limits.requests_per_connection = 3;
    TestServer test(Echo, std::move(options));
    RawClient client = test.Connect();
    client.Send(Get("/1") + Get("/2") + Get("/3") + Get("/4"));
    EXPECT_EQ(client.Read().Header("Connection"), "");
    EXPECT_EQ(client.Read().Header("Connection"), "");
    EXPECT_EQ(client.Read().Header("Connection"), "close");
    EXPECT_TRUE(client.IsClosed());
}

// Connections beyond `cap` are closed, and places that become free can be taken again.
void ExpectCap(ServerOptions options, std::size_t cap) {
    TestServer test(Echo, std::move(options));
    std::vector<std::unique_ptr<RawClient>> clients;
    for (std::size_t i = 0; i < cap; ++i) {
        clients.push_back(std::make_unique<RawClient>(test.server.port()));
        ASSERT_EQ(clients.back()->Ask(Get("/")).status, 200);
    }
    EXPECT_TRUE(test.Connect().IsClosed());
    EXPECT_EQ(clients.front()->Ask(Get("/")).status, 200);
    EXPECT_EQ(clients.front()->Ask(Get("/", "Connection: close\r\n")).status, 200);
    EXPECT_TRUE(clients.front()->IsClosed());
    clients.front()->Close();
    for (int tries = 0;; ++tries) {
        RawClient next = test.Connect();
        try {
            EXPECT_EQ(next.Ask(Get("/")).status, 200);
            return;
        } catch (const std::runtime_error&) {
            ASSERT_LT(tries, 100) << "the place does not become free";
            std::this_thread::sleep_for(milliseconds(10));
        }
    }
}

TEST(Limits, CountConnections) {
    ServerOptions in_all = TwoThreads();
    in_all.limits.connections = 3;
    ExpectCap(std::move(in_all), 3);
    ServerOptions per_address = TwoThreads();
    per_address.limits.connections_per_address = 2;
    ExpectCap(std::move(per_address), 2);
}

// Announced bodies cost nothing, those that have come count until they are answered, and a small
// form has room whatever others hold.
TEST(Limits, AddUpLargeBodiesOfAllConnections) {
    Held held;
    ServerOptions options = TwoThreads();
    options.limits.body_bytes_in_all = std::size_t{300} * 1024;
    TestServer test(held.handler(), std::move(options));
    const std::string large = Post("/", std::string(200'000, 'x'));
    RawClient silent = test.Connect();
    silent.Send(large.substr(0, 100));
    RawClient first = test.Connect();
    first.Send(large);
    const Responder respond = held.Take();
    EXPECT_EQ(test.Connect().Ask(large).status, 503);
    RawClient small = test.Connect();
    small.Send(Post("/", std::string(8000, 'x')));
    held.Take()({});
    EXPECT_EQ(small.Read().status, 200);
    respond({});
    EXPECT_EQ(first.Read().status, 200);
    std::this_thread::sleep_for(kShort);  // the room is given back behind the answer
    silent.Send(large.substr(100));
    held.Take()({});
    EXPECT_EQ(silent.Read().status, 200) << "there is room again";
}

TEST(Limits, IdleConnectionsGiveWayWhenPlacesRunOut) {
    ServerOptions options = TwoThreads();
    options.limits.connections = 4;
    options.timeouts.crowded_idle = kShort;
    TestServer test(Echo, std::move(options));
    std::vector<std::unique_ptr<RawClient>> clients;
    for (int i = 0; i < 3; ++i) {
        clients.push_back(std::make_unique<RawClient>(test.server.port()));
        ASSERT_EQ(clients.back()->Ask(Get("/")).status, 200);
    }
    const auto is_closed = [](const std::unique_ptr<RawClient>& client) {
        client->set_time_limit(3 * kShort);
        try {
            return client->IsClosed();
        } catch (const std::runtime_error&) {
            return false;
        }
    };
    EXPECT_FALSE(is_closed(clients.front())) << "three of four may stay";
    RawClient fourth = test.Connect();
    EXPECT_EQ(fourth.Ask(Get("/")).status, 200);
    // Which one goes first is as their threads look; with one gone the others may stay.
    EXPECT_TRUE(std::any_of(clients.begin(), clients.end(), is_closed));
}

TEST(Limits, AddressOfAProxyMayHaveManyConnections) {
    ServerOptions options = TwoThreads();
    options.limits.connections_per_address = 1;
    options.trusted_proxies = {"127.0.0.0/8"};
    TestServer test(Echo, std::move(options));
    RawClient first = test.Connect();
    RawClient second = test.Connect();
    EXPECT_EQ(first.Ask(Get("/")).status, 200);
    EXPECT_EQ(second.Ask(Get("/")).status, 200);
}

}  // namespace
}  // namespace zebtell::http
