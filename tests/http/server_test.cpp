#include "http/server.h"

#include <gmock/gmock.h>

#include <atomic>
#include <future>
#include <mutex>
#include <thread>

#include "base/runtime_error.h"
#include "tests/http/test_server.h"

namespace zebtell::http {
namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

Response Text(std::string body) {
    Response response;
    response.body = std::move(body);
    return response;
}

TEST(Server, AnswersPipelinedRequestsInOrder) {
    TestServer test;
    RawClient client = test.Connect();
    std::string requests;
    for (int i = 0; i < 50; ++i) requests += Get("/" + std::to_string(i)) + Post("/p", "b");
    client.Send(requests);
    for (int i = 0; i < 50; ++i) {
        ASSERT_EQ(client.Read().body, "GET|/" + std::to_string(i) + "|");
        ASSERT_EQ(client.Read().body, "POST|/p|b");
    }
}

TEST(Server, TakesRequestByteByByte) {
    TestServer test;
    RawClient client = test.Connect();
    for (const char c : Post("/a", "hello")) client.Send(std::string(1, c));
    EXPECT_EQ(client.Read().body, "POST|/a|hello");
}

TEST(Server, SendsItsOwnHeadersAndNobodyElses) {
    TestServer test([](const Request&, const Responder& respond) {
        Response response;
        response.headers = {{"X-Name", "a\r\nSet-Cookie: b=1"}};
        response.shared_body = std::make_shared<const std::string>("shared");
        respond(std::move(response));
    });
    RawClient client = test.Connect();
    const RawResponse response = client.Ask(Get("/"));
    EXPECT_EQ(response.body, "shared");
    EXPECT_EQ(response.Header("Server"), "ZEBTell");
    EXPECT_EQ(response.Header("Set-Cookie"), "");
    EXPECT_EQ(response.Header("Connection"), "");
    EXPECT_THAT(response.Header("Date"),
                ::testing::MatchesRegex("[A-Z][a-z]{2}, [0-9]{2} [A-Z][a-z]{2} [0-9]{4} "
                                        "[0-9]{2}:[0-9]{2}:[0-9]{2} GMT"));
}

TEST(Server, LeavesTheBodyOutForHeadAndBodylessStatuses) {
    TestServer test([](const Request& request, const Responder& respond) {
        Response response = Text("body");
        if (request.target == "/304") response.status = 304;
        if (request.target == "/204") response.status = 204;
        respond(std::move(response));
    });
    RawClient client = test.Connect();
    client.Send("HEAD / HTTP/1.1\r\nHost: shop\r\n\r\n" + Get("/304") + Get("/204") + Get("/"));
    EXPECT_EQ(client.Read(true).Header("Content-Length"), "4");
    EXPECT_EQ(client.Read().status, 304);
    EXPECT_EQ(client.Read().status, 204);
    EXPECT_EQ(client.Read().body, "body");
}

TEST(Server, KeepsConnectionAsTheClientWishes) {
    struct Row {
        const char* request;
        const char* connection;
        bool closes;
    };
    const Row rows[] = {
        {"GET / HTTP/1.1\r\nHost: a\r\n\r\n", "", false},
        {"GET / HTTP/1.1\r\nHost: a\r\nConnection: Close\r\n\r\n", "close", true},
        {"GET / HTTP/1.0\r\n\r\n", "close", true},
        {"GET / HTTP/1.0\r\nConnection: keep-alive\r\n\r\n", "keep-alive", false},
    };
    TestServer test;
    for (const Row& row : rows) {
        SCOPED_TRACE(row.request);
        RawClient client = test.Connect();
        EXPECT_EQ(client.Ask(row.request).Header("Connection"), row.connection);
        if (row.closes) {
            EXPECT_TRUE(client.IsClosed());
        } else {
            EXPECT_EQ(client.Ask(Get("/again")).status, 200);
        }
    }
}

TEST(Server, RefusesWithStatusAndCloses) {
    TestServer test;
    RawClient client = test.Connect();
    client.Send(Get("/good") + "DELETE / HTTP/1.1\r\nHost: a\r\n\r\n" + Get("/never"));
    EXPECT_EQ(client.Read().status, 200);
    const RawResponse refused = client.Read();
    EXPECT_EQ(refused.status, 405);
    EXPECT_EQ(refused.Header("Allow"), "GET, HEAD, POST");
    EXPECT_EQ(refused.Header("Connection"), "close");
    EXPECT_TRUE(client.IsClosed());
}

TEST(Server, AsksForTheBodyThatWaitsToBeAskedFor) {
    TestServer test;
    const std::string head =
        "POST /a HTTP/1.1\r\nHost: a\r\nExpect: 100-continue\r\nContent-Length: ";
    RawClient client = test.Connect();
    EXPECT_EQ(client.Ask(head + "2\r\n\r\n").status, 100);
    EXPECT_EQ(client.Ask("ab").body, "POST|/a|ab");
    // A client that does not wait is not asked, and one with too much is told so at once.
    EXPECT_EQ(client.Ask(head + "2\r\n\r\ncd").body, "POST|/a|cd");
    EXPECT_EQ(client.Ask(head + "99999999\r\n\r\n").status, 413);
}

// Browsers are told to be strict by every answer, also by those that no handler made.
TEST(Server, EveryAnswerIsStrict) {
    ServerOptions options = TwoThreads();
    options.trusted_proxies = {"127.0.0.1"};
    TestServer test(
        [](const Request& request, const Responder& respond) {
            Response response = Text("x");
            if (request.target == "/own") {
                response.headers = {{"content-security-policy", "default-src 'none'"}};
            }
            respond(std::move(response));
        },
        std::move(options));
    const std::string over_tls = "X-Forwarded-Proto: https\r\n";
    for (const std::string& request :
         {Get("/"), Get("/", over_tls), Get("http://a/"), std::string("TEA / HTTP/1.1\r\n\r\n")}) {
        const RawResponse answer = test.Connect().Ask(request);
        EXPECT_EQ(answer.Header("X-Content-Type-Options"), "nosniff") << request;
        EXPECT_EQ(answer.Header("Referrer-Policy"), "same-origin") << request;
        EXPECT_THAT(answer.Header("Content-Security-Policy"),
                    ::testing::StartsWith("default-src 'self'; frame-ancestors 'self';"))
            << request;
        EXPECT_EQ(answer.Header("Strict-Transport-Security"),
                  request == Get("/", over_tls) ? "max-age=31536000" : "");
    }
    EXPECT_EQ(test.Connect().Ask(Get("/own")).Header("Content-Security-Policy"),
              "default-src 'none'");
}

TEST(Responder, AnswersFromAnotherThread) {
    Held held;
    TestServer test(held.handler());
    RawClient client = test.Connect();
    for (int i = 0; i < 20; ++i) {
        client.Send(Get("/"));
        std::thread([respond = held.Take(), i] { respond(Text(std::to_string(i))); }).join();
        ASSERT_EQ(client.Read().body, std::to_string(i));
    }
}

TEST(Responder, FirstAnswerCountsAndBadStatusIsAnError) {
    TestServer test([](const Request& request, const Responder& respond) {
        Response response = Text("first");
        if (request.target == "/bad") response.status = 99;
        respond(std::move(response));
        respond(Text("second"));
    });
    RawClient client = test.Connect();
    EXPECT_EQ(client.Ask(Get("/")).body, "first");
    EXPECT_EQ(client.Ask(Get("/")).body, "first");
    EXPECT_EQ(client.Ask(Get("/bad")).status, 500);
}

TEST(Responder, DroppedOrThrownIsAnError) {
    std::vector<std::string> log;
    ServerOptions options = TwoThreads();
    options.log = [&](std::string_view text) { log.emplace_back(text); };
    TestServer test(
        [](const Request& request, const Responder&) {
            if (request.target == "/throw") throw std::runtime_error("no bread");
        },
        std::move(options));
    RawClient client = test.Connect();
    EXPECT_EQ(client.Ask(Get("/drop")).status, 500);
    EXPECT_EQ(client.Ask(Get("/throw")).status, 500);
    test.server.Stop();
    EXPECT_THAT(log, ::testing::ElementsAre("Request handler: no bread"));
}

TEST(Responder, MayBeCalledAfterTheClientAndTheServerHaveGone) {
    Held held;
    Responder kept;
    {
        ServerOptions options = TwoThreads();
        options.timeouts.stop = milliseconds(50);
        TestServer test(held.handler(), std::move(options));
        RawClient client = test.Connect();
        client.Send(Get("/"));
        const Responder respond = held.Take();
        client.Close();
        // More than fits into the socket's buffers, so that writing meets the closed connection.
        respond(Text(std::string(8 * 1024 * 1024, 'x')));
        RawClient other = test.Connect();
        other.Send(Get("/"));
        held.Take()(Text("alive"));
        EXPECT_EQ(other.Read().body, "alive");
        other.Send(Get("/"));
        kept = held.Take();
        other.Close();
    }
    kept(Text("nobody"));
}

TEST(Responder, AnswersWhileTheServerStops) {
    for (int i = 0; i < 20; ++i) {
        Held held;
        ServerOptions options = TwoThreads();
        options.timeouts.stop = milliseconds(5);
        TestServer test(held.handler(), std::move(options));
        RawClient client = test.Connect();
        client.Send(Get("/"));
        std::thread answering([respond = held.Take()] {
            std::this_thread::sleep_for(milliseconds(10));
            respond(Text("late"));
        });
        test.server.Stop();
        answering.join();
    }
}

TEST(Stop, LetsRunningRequestFinish) {
    Held held;
    TestServer test(held.handler());
    RawClient running = test.Connect();
    RawClient idle = test.Connect();
    running.Send(Get("/"));
    const Responder respond = held.Take();
    auto stopped = std::async(std::launch::async, [&] { test.server.Stop(); });
    EXPECT_TRUE(idle.IsClosed());
    EXPECT_THROW(test.Connect(), std::runtime_error);
    respond(Text("done"));
    const RawResponse response = running.Read();
    EXPECT_EQ(response.body, "done");
    EXPECT_EQ(response.Header("Connection"), "close");
    EXPECT_TRUE(running.IsClosed());
    running.Close();
    EXPECT_EQ(stopped.wait_for(seconds(5)), std::future_status::ready);
}

TEST(Stop, EndsInTimeWhateverClientsDo) {
    Held held;
    ServerOptions options = TwoThreads();
    options.timeouts.stop = milliseconds(200);
    TestServer test(held.handler(), std::move(options));
    RawClient never_answered = test.Connect();
    never_answered.Send(Get("/"));
    const Responder unanswered = held.Take();
    RawClient slow_head = test.Connect();
    slow_head.Send("GET / HT");
    RawClient slow_body = test.Connect();
    slow_body.Send("POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 9\r\n\r\nab");
    RawClient slow_reader = test.Connect();
    slow_reader.Send(Get("/"));
    held.Take()(Text(std::string(16 * 1024 * 1024, 'x')));
    const auto begin = std::chrono::steady_clock::now();
    test.server.Stop();
    EXPECT_LT(std::chrono::steady_clock::now() - begin, seconds(1));
}

// The last connection's end and the timer that watches the stop fall together: the IO thread is
// held up, by freeing a response, until both are due.
TEST(Stop, EndsWhenItsTimerIsDueWithTheLastClose) {
    Held held;
    ServerOptions options = TwoThreads();
    options.io_threads = 1;
    TestServer test(held.handler(), std::move(options));
    RawClient last = test.Connect();
    last.Send(Get("/") + "GET / HT");
    held.Take()(Text("its next request has begun"));
    last.Read();
    RawClient first = test.Connect();
    first.Send(Get("/"));
    const Responder respond = held.Take();
    auto stopped = std::async(std::launch::async, [&] { test.server.Stop(); });
    std::this_thread::sleep_for(milliseconds(20));
    std::promise<void> freeing;
    Response response;
    response.shared_body = std::shared_ptr<const std::string>(
        std::make_unique<const std::string>(16 * 1024 * 1024, 'x').release(),
        [&freeing](const std::string* body) {
            const std::unique_ptr<const std::string> freed(body);
            freeing.set_value();
            std::this_thread::sleep_for(milliseconds(50));
        });
    respond(std::move(response));
    std::this_thread::sleep_for(milliseconds(20));
    first.Close();
    freeing.get_future().wait();
    last.Close();
    EXPECT_EQ(stopped.wait_for(seconds(2)), std::future_status::ready);
}

TEST(Server, StartsAgainAndTellsWhatItCannotUse) {
    TestServer test;
    test.server.Stop();
    test.server.Stop();
    test.server.Start();
    EXPECT_EQ(test.Connect().Ask(Get("/a")).status, 200);

    ServerOptions taken = TwoThreads();
    taken.port = test.server.port();
    EXPECT_THROW(Server(taken, Echo).Start(), base::RuntimeError);
    ServerOptions no_key = TwoThreads();
    no_key.certificate_file = "/nowhere.pem";
    EXPECT_THROW(Server(no_key, Echo).Start(), base::RuntimeError);
    ServerOptions no_network = TwoThreads();
    no_network.trusted_proxies = {"10.0.0.0/33"};
    EXPECT_THROW(Server(no_network, Echo), base::RuntimeError);
}

}  // namespace
}  // namespace zebtell::http
