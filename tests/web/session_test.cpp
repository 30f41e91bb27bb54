#include <gtest/gtest.h>

#include <latch>
#include <set>
#include <thread>

#include "web/session_cookie.h"
#include "web/session_store.h"

namespace zebtell::web {
namespace {

class SessionStoreTest : public testing::Test {
  protected:
    SessionStore::Created Make() { return store.Create().value(); }

    std::chrono::steady_clock::time_point now;
    WorkerPool pool{1};
    SessionStore store{
        pool,
        {.idle = std::chrono::minutes(20), .max_sessions = 3, .queue_limit = 32, .clock = [this] {
             return now;
         }}};
};

TEST_F(SessionStoreTest, IdleSessionsExpire) {
    const auto used = Make();
    now += std::chrono::minutes(5);
    const auto idle = Make();
    store.Touch(*idle.session, Standing::kUser);
    now += std::chrono::minutes(15);
    EXPECT_EQ(store.Find(used.token), used.session);
    now += std::chrono::minutes(5) + std::chrono::seconds(1);
    EXPECT_EQ(store.Find(idle.token), nullptr) << "also before it is swept";
    EXPECT_TRUE(store.TakeExpired().empty());
    now += std::chrono::minutes(20);
    EXPECT_EQ(store.TakeExpired(), std::vector{used.session});
    EXPECT_EQ(store.Find(used.token), nullptr);
    EXPECT_EQ(store.Count().all, 0U);
    store.Touch(*used.session, Standing::kUser);  // its last request ends after it has left
    EXPECT_FALSE(store.RenewToken(*used.session));
    EXPECT_EQ(store.Count().all, 0U);
}

TEST_F(SessionStoreTest, AFullStoreLetsTheLongestIdleAndLeastKnownSessionGo) {
    const auto make = [&](Standing standing) {
        auto made = Make();
        store.Touch(*made.session, standing);
        return std::pair(std::move(made.token), std::move(made.evicted));
    };
    const auto is_there = [&](const std::string& token) { return store.Find(token) != nullptr; };
    const std::string user = make(Standing::kUser).first;
    const std::string guest = make(Standing::kGuest).first;
    const std::string first = make(Standing::kAnonymous).first;
    const auto [second, evicted] = make(Standing::kAnonymous);
    EXPECT_TRUE(evicted) << "is destroyed by the caller, not under the lock";
    EXPECT_TRUE(!is_there(first) && is_there(second) && is_there(guest));
    const auto running = store.Find(second);
    const auto third = Make();
    EXPECT_TRUE(!is_there(guest) && is_there(second)) << "has a request under way";
    EXPECT_FALSE(store.Create()) << "user, running, running";
    store.Touch(*third.session, Standing::kUser);
    store.Touch(*running, Standing::kUser);
    EXPECT_EQ(store.Count().logged_on, 3U);
    EXPECT_FALSE(store.Create()) << "no user is pushed out";
    now += std::chrono::minutes(21);
    EXPECT_TRUE(store.Create()) << "but who is gone is";
    EXPECT_FALSE(is_there(user));
}

TEST_F(SessionStoreTest, TokensAreUnguessableAndRenewed) {
    const auto made = Make();
    std::set<std::string> tokens{made.token};
    for (int i = 0; i < 100; ++i) {
        const auto token = store.RenewToken(*made.session);
        ASSERT_TRUE(token && token->size() == 32 && tokens.insert(*token).second);
        ASSERT_EQ(store.Find(*token), made.session);
    }
    EXPECT_EQ(store.Find(made.token), nullptr);
    EXPECT_EQ(store.Find(""), nullptr);
    EXPECT_EQ(store.Find(made.session->session_id), nullptr);
    EXPECT_EQ(store.Count().all, 1U);
    EXPECT_EQ(std::stoul(Make().session->session_id), std::stoul(made.session->session_id) + 1);
}

TEST_F(SessionStoreTest, ManyThreadsUseItAtOnce) {
    std::vector<std::jthread> threads;
    for (int i = 0; i < 4; ++i) {
        threads.emplace_back([&, i] {
            for (int round = 0; round < 500; ++round) {
                auto made = store.Create();
                if (!made) continue;
                store.Find(made->token);
                store.Touch(*made->session,
                            round % 2 == 0 ? Standing::kUser : Standing::kAnonymous);
                store.RenewToken(*made->session);
                if (i == 0) store.TakeExpired();
                store.Touch(*made->session, Standing::kAnonymous);
            }
        });
    }
    threads.clear();
    EXPECT_LE(store.Count().all, 3U);
    EXPECT_EQ(store.Count().logged_on, 0U);
}

TEST(SessionCookie, IsFoundAmongOthers) {
    const http::Request request{.method = "GET",
                                .target = "/",
                                .headers = {{"cookie", "a=b; ZEBTell=one;ZEBTellX=no"},
                                            {"Cookie", "xZEBTell=no; ZEBTell=two"}},
                                .body = {},
                                .remote_address = {}};
    EXPECT_EQ(SessionTokens(request), (std::vector<std::string_view>{"one", "two"}));
    EXPECT_EQ(SessionCookie("t", "/portal/", true),
              "ZEBTell=t; Path=/portal; HttpOnly; SameSite=Lax; Secure");
}

TEST(SerialQueue, RunsQuickTasksHereWhenIdleAndTheOthersInOrderOnThePool) {
    WorkerPool pool(2);
    const auto queue = std::make_shared<SerialQueue>(pool, 3);
    std::string order;
    std::thread::id quick_thread, slow_thread;
    std::latch slow_may_end(1), all_done(1);
    ASSERT_TRUE(queue->Submit(
        [&] {
            quick_thread = std::this_thread::get_id();
            order += "a";
        },
        Work::kQuick));
    EXPECT_EQ(quick_thread, std::this_thread::get_id());
    std::latch slow_runs(1);
    ASSERT_TRUE(queue->Submit(
        [&] {
            slow_thread = std::this_thread::get_id();
            slow_runs.count_down();
            slow_may_end.wait();
            order += "b";
        },
        Work::kMayWait));
    slow_runs.wait();
    ASSERT_TRUE(queue->Submit([&] { order += "c"; }, Work::kQuick)) << "waits its turn";
    ASSERT_TRUE(queue->Submit([&] { order += "d"; }, Work::kMayWait));
    ASSERT_TRUE(queue->Submit(
        [&] {
            order += "e";
            all_done.count_down();
        },
        Work::kQuick));
    EXPECT_FALSE(queue->Submit([&] { order += "never"; }, Work::kQuick)) << "full";
    slow_may_end.count_down();
    all_done.wait();
    pool.Stop();
    EXPECT_EQ(order, "abcde");
    EXPECT_NE(slow_thread, quick_thread);
    ASSERT_TRUE(queue->Submit([&] { order += "f"; }, Work::kQuick)) << "idle again";
    EXPECT_EQ(order, "abcdef");
}

TEST(WorkerPool, StopRunsWhatWasPostedAndEndsTheTimers) {
    WorkerPool pool(2);
    std::atomic<int> ran = 0;
    std::atomic<int> ticks = 0;
    std::latch ticked(2);
    pool.Every(std::chrono::milliseconds(1), [&] {
        if (++ticks <= 2) ticked.count_down();
    });
    ticked.wait();
    for (int i = 0; i < 100; ++i) pool.Post([&] { ++ran; });
    pool.Stop();
    EXPECT_EQ(ran, 100);
    const int ticks_at_end = ticks;
    std::this_thread::sleep_for(std::chrono::milliseconds(20));
    EXPECT_EQ(ticks, ticks_at_end);
}

}  // namespace
}  // namespace zebtell::web
