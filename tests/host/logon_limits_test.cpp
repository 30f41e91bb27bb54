#include "host/logon_limits.h"

#include <gtest/gtest.h>

namespace zebtell::host {
namespace {

using std::chrono::hours;
using std::chrono::minutes;
using std::chrono::seconds;

class LogonLimitsTest : public testing::Test {
  protected:
    // How many tries in a row are let through, all of them wrong.
    int Tries(const std::string& user, const std::string& address, int most = 1000) {
        int tries = 0;
        while (tries < most && limits.Enter(user, address) == seconds(0)) ++tries;
        return tries;
    }
    // Of one name from many networks.
    int TriesFromEverywhere(const std::string& user) {
        int tries = 0;
        for (int i = 0; i < 1000; ++i) {
            tries +=
                Tries(user, "10.1." + std::to_string(i / 250) + "." + std::to_string(i % 250), 1);
        }
        return tries;
    }

    std::chrono::steady_clock::time_point now;
    LogonLimits limits{[this] { return now; }};
};

TEST_F(LogonLimitsTest, OneNameFromOneNetwork) {
    EXPECT_EQ(Tries("mari", "10.0.0.1"), 50);
    EXPECT_EQ(limits.Enter("Mari", "10.0.0.1"), seconds(60)) << "in other letters";
    EXPECT_EQ(Tries("jaan", "10.0.0.1", 5), 5);
    EXPECT_EQ(Tries("mari", "10.0.0.2", 5), 5);
    now += minutes(3);
    EXPECT_EQ(Tries("mari", "10.0.0.1"), 3) << "one a minute";
    now += hours(1);
    EXPECT_EQ(Tries("mari", "10.0.0.1"), 50);
}

TEST_F(LogonLimitsTest, ManyNamesFromOneNetwork) {
    const auto spray = [&](const std::string& address) {
        int tries = 0;
        for (int i = 0; i < 1000; ++i) tries += Tries("user" + std::to_string(i), address, 1);
        return tries;
    };
    EXPECT_EQ(spray("10.0.0.1"), 300);
    EXPECT_EQ(spray("2001:db8:1:2::1"), 300);
    EXPECT_EQ(spray("2001:db8:1:2:ffff::9"), 0) << "the same /64";
    EXPECT_EQ(Tries("mari", "2001:db8:1:3::1", 5), 5);
    EXPECT_EQ(spray("127.0.0.1"), 1000) << "a proxy of this machine, for all its clients";
}

TEST_F(LogonLimitsTest, WhoGuessesFromEverywhereDoesNotKeepTheCustomerOut) {
    ASSERT_EQ(limits.Enter("mari", "10.0.0.1"), seconds(0));
    limits.Succeeded("mari", "10.0.0.1");
    EXPECT_EQ(TriesFromEverywhere("mari"), 100);
    EXPECT_GT(limits.Enter("mari", "10.9.9.9"), seconds(0));
    EXPECT_EQ(Tries("mari", "10.0.0.1"), 50) << "where she usually comes from";
    now += hours(24 * 31);
    EXPECT_EQ(TriesFromEverywhere("mari"), 100);
    EXPECT_GT(limits.Enter("mari", "10.0.0.1"), seconds(0)) << "for a month";
}

TEST_F(LogonLimitsTest, SuccessesAreNotCounted) {
    for (int i = 0; i < 2000; ++i) {
        ASSERT_EQ(limits.Enter("mari", "10.0.0.1"), seconds(0)) << i;
        limits.Succeeded("mari", "10.0.0.1");
    }
    EXPECT_EQ(Tries("mari", "10.0.0.1"), 50);
}

TEST(LeakyBuckets, ForgetTheOldestKeyOnly) {
    const LeakyBuckets::Time now;
    LeakyBuckets buckets({.room = 1, .per_minute = 1}, 100);
    const auto key = [](int i) { return web::TokenKey::Of(std::to_string(i)); };
    for (int i = 0; i < 101; ++i) buckets.Add(key(i), now);
    EXPECT_EQ(buckets.size(), 100U);
    EXPECT_EQ(buckets.WaitFor(key(0), now), seconds(0));
    EXPECT_EQ(buckets.WaitFor(key(1), now), seconds(60));
    buckets.TakeBack(key(1), now);
    EXPECT_EQ(buckets.WaitFor(key(1), now), seconds(0));
}

}  // namespace
}  // namespace zebtell::host
