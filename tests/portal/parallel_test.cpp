#include <gmock/gmock.h>

#include <atomic>
#include <thread>
#include <vector>

#include "tests/portal/portal_fixture.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;

using Parallel = PortalTest;

// Runs `work` on as many threads and waits for all.
template <class Work>
void OnThreads(int count, Work work) {
    std::vector<std::thread> threads;
    for (int i = 0; i < count; ++i) threads.emplace_back(work, i);
    for (auto& thread : threads) thread.join();
}

TEST_F(Parallel, EachSessionIsSerialInItself) {
    // Three tabs of each of two sessions add rows at the same time: none is lost or counted twice.
    Browser sessions[] = {MariLoggedOn(), MariLoggedOn()};
    for (Browser& session : sessions) session.Get("Kaubainfo");
    OnThreads(6, [&](int i) {
        Browser tab = sessions[i % 2];
        for (int n = 0; n < 20; ++n) {
            tab.Ask("/?page=Kaubainfo&event=Lisamine", "POST", "ID_1101=1&ID_1102=2");
        }
    });
    for (Browser& session : sessions) {
        EXPECT_THAT(session.Get("Kaubainfo"),
                    HasSubstr("[basket rows=120 quantity=180 total=549,60]"));
    }
}

TEST_F(Parallel, OneConfirmationPostedAtOnceIsOneOrder) {
    Browser mari = MariLoggedOn();
    mari.Get("Kaubainfo");
    mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "3"}});
    std::atomic<int> stored = 0;
    OnThreads(4, [&](int) {
        Browser tab = mari;
        const auto answer =
            tab.Ask("/?page=Kinnitus&event=LisaTellimus", "POST", "ZEB_But_Vormista=1");
        if (answer.Header("Location") == "/?page=Tellimus") ++stored;
    });
    EXPECT_EQ(stored, 4) << "every click is led to the order";
    EXPECT_EQ(company().Run("SELECT count(*), sum(Amount) FROM SDOrder WHERE Number > 7003"),
              "1|25.5\n");
}

TEST_F(Parallel, OrdersOfManySessionsGetNumbersOfTheirOwn) {
    OnThreads(4, [&](int) {
        Browser mari = MariLoggedOn();
        for (int n = 0; n < 5; ++n) {
            mari.Post("Kaubainfo&event=Lisamine", {{"ID_1101", "1"}});
            mari.Post("Kinnitus&event=LisaTellimus", {{"ZEB_But_Vormista", "1"}});
        }
    });
    EXPECT_EQ(company().Run("SELECT count(*), min(Number), max(Number), sum(AmountWTax), "
                            "sum(NeedsReview) FROM SDOrder WHERE Number > 7003"),
              "20|7004|7023|210.8|0\n");
    EXPECT_EQ(company().Run("PRAGMA integrity_check; PRAGMA foreign_key_check"), "ok\n");
}

}  // namespace
}  // namespace zebtell
