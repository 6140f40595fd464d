#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Fix;
using server::Precision;
using server::Store;

/// Who wants a newer fix than there is: otto sees ann exactly, mara sees nobody.
class StoreWishes : public StoreContract {
  protected:
    std::int64_t wish(std::int64_t viewer, const std::string& handle, std::int64_t now) {
        std::promise<std::int64_t> since;
        store_->wishForFix(viewer, {handle}, now, [&](const auto& all) { since.set_value(all ? all->front() : -1); });
        return since.get_future().get();
    }
    bool takes(std::int64_t now, std::int64_t newest = 0) {
        std::promise<bool> asked;
        store_->takeWishes(ann_, newest, now, [&](bool isAsked) { asked.set_value(isAsked); });
        return asked.get_future().get();
    }
};

TEST_P(StoreWishes, Wish_IsTakenOnce_AndStandsForTwentyMinutes) {
    EXPECT_FALSE(takes(kNow));
    EXPECT_EQ(wish(otto_, "Ann@x.example", kNow), kNow);
    EXPECT_EQ(wish(otto_, "ann@X.example", kNow + 60), kNow);
    EXPECT_TRUE(takes(kNow + 61));
    EXPECT_FALSE(takes(kNow + 62));
    // Whoever asks again cannot tell that a phone was told.
    EXPECT_EQ(wish(otto_, "ann@x.example", kNow + 63), kNow);
    EXPECT_FALSE(takes(kNow + 64));
    EXPECT_EQ(wish(otto_, "ann@x.example", kNow + Store::kWishLasts), kNow + Store::kWishLasts);
    // Told 20 minutes ago and not before.
    EXPECT_FALSE(takes(kNow + Store::kWishLasts + 30));
    EXPECT_TRUE(takes(kNow + Store::kWishLasts + 61));
}

TEST_P(StoreWishes, WishThatNobodyTook_IsOverAfterTwentyMinutes) {
    wish(otto_, "ann@x.example", kNow);
    EXPECT_FALSE(takes(kNow + Store::kWishLasts));
}

TEST_P(StoreWishes, FixFromAfterTheWish_LeavesNothingToAskFor) {
    wish(otto_, "ann@x.example", kNow);
    EXPECT_FALSE(takes(kNow + 10, kNow + 5));
    ASSERT_TRUE(keep({at(kNow + 5)}, kNow + 10));
    EXPECT_FALSE(takes(kNow + 20));
}

TEST_P(StoreWishes, FixFromBeforeTheWish_IsNotEnough) {
    ASSERT_TRUE(keep({at(kNow - 5)}));
    wish(otto_, "ann@x.example", kNow);
    EXPECT_TRUE(takes(kNow + 10, kNow - 1));
}

TEST_P(StoreWishes, OnlyWhoSeesExactly_MakesAPhoneWork_AndEverybodyHearsTheSame) {
    EXPECT_EQ(wish(mara_, "ann@x.example", kNow), kNow);
    EXPECT_EQ(wish(mara_, "nobody@x.example", kNow), kNow);
    EXPECT_EQ(wish(mara_, std::string("\xff\0x", 3), kNow), kNow);
    EXPECT_FALSE(takes(kNow + 1));
    for (const Precision coarse : {Precision::Kilometre, Precision::Town, Precision::Places}) {
        ASSERT_TRUE(store_->grant(ann_, otto_, {coarse, kNow - 1000, std::nullopt}));
        EXPECT_EQ(wish(otto_, "ann@x.example", kNow), kNow);
        EXPECT_FALSE(takes(kNow + 1));
    }
}

TEST_P(StoreWishes, WhoeverHides_IsNotAsked_AlsoNotAfterwardsForAWishFromBefore) {
    ASSERT_TRUE(store_->setHidden(ann_, true, kNow));
    EXPECT_EQ(wish(otto_, "ann@x.example", kNow), kNow);
    EXPECT_FALSE(takes(kNow + 1));
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow + 60));
    EXPECT_FALSE(takes(kNow + 61));
}

TEST_P(StoreWishes, GrantThatEndedOrBeganSince_MakesNobodyWork) {
    wish(otto_, "ann@x.example", kNow);
    ASSERT_TRUE(store_->revokeGrant(ann_, otto_));
    EXPECT_FALSE(takes(kNow + 1));
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, kNow + 2, std::nullopt}));
    EXPECT_FALSE(takes(kNow + 3));
    ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Exact, kNow - 1000, kNow + 10}));
    wish(mara_, "ann@x.example", kNow + 5);
    EXPECT_FALSE(takes(kNow + 10));
}

TEST_P(StoreWishes, WhoHasSeveralHandles_IsAskedOnceByOneViewer) {
    ASSERT_TRUE(store_->addPerson("zoe", {"zoe@x.example", "+44 1632 960001"}, kNow));
    ann_ = store_->personNamed("zoe")->id;
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, kNow - 1000, std::nullopt}));
    wish(otto_, "zoe@x.example", kNow);
    EXPECT_TRUE(takes(kNow + 1));
    EXPECT_EQ(wish(otto_, "+441632960001", kNow + 2), kNow + 2);
    EXPECT_FALSE(takes(kNow + 3));
}

TEST_P(StoreWishes, TooManyAtOnce_AreNotKept_WhoeverTheyAreAbout) {
    for (int i = 0; i < Store::kMostWishes; ++i) {
        EXPECT_EQ(wish(otto_, "nobody" + std::to_string(i) + "@x.example", kNow), kNow);
    }
    EXPECT_EQ(wish(otto_, "ann@x.example", kNow), 0);
    EXPECT_EQ(wish(otto_, "nobody@x.example", kNow), 0);
    EXPECT_EQ(wish(otto_, "nobody1@x.example", kNow + 1), kNow);
    EXPECT_FALSE(takes(kNow + 1));
    EXPECT_EQ(wish(otto_, "ann@x.example", kNow + Store::kWishLasts), kNow + Store::kWishLasts);
}

TEST_P(StoreWishes, OldWishes_AreDeleted_AndGoWithTheirPerson) {
    wish(otto_, "ann@x.example", kNow);
    EXPECT_NE(store_->everythingOf(otto_)->find("fix_wish")->array()->size(), 0U);
    EXPECT_EQ(store_->everythingOf(ann_)->find("fix_wish")->array()->size(), 0U);
    ASSERT_TRUE(finished([&](auto done) { store_->deleteOld(kNow + 2 * Store::kWishLasts, done); }));
    EXPECT_EQ(store_->everythingOf(otto_)->find("fix_wish")->array()->size(), 0U);
    wish(otto_, "ann@x.example", kNow);
    EXPECT_TRUE(store_->forget(otto_, kNow));
    EXPECT_FALSE(takes(kNow + 1));
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreWishes, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreWishes, ::testing::Values(true));

}  // namespace ktr::test
