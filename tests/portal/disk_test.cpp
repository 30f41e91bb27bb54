#include <gmock/gmock.h>

#include <optional>

#include "tests/portal/portal_fixture.h"
#include "tests/portal/watched_disk.h"

namespace zebtell {
namespace {

using ::testing::HasSubstr;

// An order is answered when it is on the disk, and not otherwise.
class Disk : public PortalTest {
  protected:
    void SetUp() override {
        WatchedDisk::Get();
        PortalTest::SetUp();
        mari_.emplace(MariLoggedOn());
        mari_->Get("Kaubainfo");
        mari_->Post("Kaubainfo&event=Lisamine", {{"ID_1101", "3"}});
    }
    const std::string& Confirm() {
        return mari_->Post("Kinnitus&event=LisaTellimus",
                           {{"ZEB_But_Vormista", "1"}, {"ZEB_Komment", "kiire"}});
    }
    void ExpectRefusedAndBasketKept() {
        EXPECT_THAT(Confirm(), HasSubstr("(Probleem tellimuse salvestamisel!) sum=25,50"));
        EXPECT_THAT(mari_->page(), HasSubstr("comment=kiire"));
        EXPECT_EQ(NewOrders(), "");
    }
    std::string NewOrders() const {
        return company().Run("SELECT Number, Amount, Explanation FROM SDOrder WHERE Number > 7003");
    }

    WatchedDisk& disk_ = WatchedDisk::Get();
    std::optional<Browser> mari_;
};

TEST_F(Disk, HasTheOrderBeforeTheCustomerHasTheAnswer) {
    disk_.syncs = 0;
    const auto answer =
        mari_->Ask("/?page=Kinnitus&event=LisaTellimus", "POST", "ZEB_But_Vormista=1");
    EXPECT_EQ(answer.Header("Location"), "/?page=Tellimus");
    EXPECT_GE(disk_.syncs, 1);
    EXPECT_EQ(disk_.unsynced_writes, 0);
}

TEST_F(Disk, ASyncThatFailsIsAnErrorAndTheConnectionIsGivenUp) {
    disk_.syncs = 0;
    disk_.uses_in_doubt = 0;
    disk_.failing_syncs = 1;
    ExpectRefusedAndBasketKept();
    EXPECT_EQ(disk_.syncs, 1) << "not tried again behind the customer's back";
    EXPECT_THAT(Confirm(), HasSubstr("just saved number=7004"));
    EXPECT_EQ(NewOrders(), "7004|25.5|kiire\n");
    EXPECT_EQ(disk_.uses_in_doubt, 0);
}

TEST_F(Disk, WithoutRoomKeepsTheBasketAndTheShopOpen) {
    disk_.full = true;
    ExpectRefusedAndBasketKept();
    EXPECT_THAT(mari_->Get("Kaubainfo"), HasSubstr("[basket rows=1 "));
    disk_.full = false;
    EXPECT_THAT(Log(), HasSubstr("There is no room left for the company database"));
    EXPECT_THAT(Confirm(), HasSubstr("just saved number=7004"));
    EXPECT_EQ(NewOrders(), "7004|25.5|kiire\n");
    EXPECT_EQ(company().Run("PRAGMA integrity_check"), "ok\n");
}

}  // namespace
}  // namespace zebtell
