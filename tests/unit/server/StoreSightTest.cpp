// What is read of people's fixes to say where they are: as much as decides it.
#include <gtest/gtest.h>

#include <algorithm>

#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Fix;
using server::Precision;
using server::Visibility;

class StoreSight : public StoreContract {
  protected:
    void SetUp() override {
        StoreContract::SetUp();
        if (IsSkipped() || HasFatalFailure()) {
            return;
        }
        ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Kilometre, kNow, std::nullopt}));
        // Two days on the way, and in another cell with each slot.
        std::vector<Fix> fixes;
        for (std::int64_t time = kNow + 3600; time < kToday; time += 300) {
            fixes.push_back({time, time, 50.0, longitude_ += 0.02, 12.0});
        }
        ASSERT_TRUE(keep(std::move(fixes), kToday));
    }
    /// What Mara sees of Ann, and how many fixes were read for it; the same as with all of them.
    std::uint64_t readFor(std::int64_t now) {
        const std::uint64_t before = store_->fixesRead();
        const auto asked = store_->asked(mara_, {"ann@x.example"}, now);
        const std::uint64_t read = store_->fixesRead() - before;
        EXPECT_TRUE(asked);
        const auto seen = Visibility::visible(asked->front().sharing, now);
        EXPECT_TRUE(seen);
        EXPECT_EQ(seen, Visibility::visible(*store_->sharing(mara_, ann_), now));
        return read;
    }

    /// For 25 minutes, heard at once.
    void goOn() {
        for (std::int64_t time = kToday; time < kToday + 1500; time += 60) {
            ASSERT_TRUE(keep({{time, time, 50.0, longitude_ += 0.02, 12.0}}, time));
        }
    }

    static constexpr std::int64_t kToday = kNow + 2L * 86400;
    double longitude_ = -3.0;
};
INSTANTIATE_TEST_SUITE_P(Sqlite, StoreSight, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreSight, ::testing::Values(true));

TEST_P(StoreSight, OfSomebodyWhoNeverRests_IsReadOnceAsFarBack) {
    std::int64_t now = kToday + 1500;
    goOn();
    EXPECT_GT(readFor(now), 500U);
    for (int minute = 0; minute < 60; ++minute, now += 60) {
        EXPECT_LE(readFor(now), 6U) << minute;
        ASSERT_TRUE(keep({{now, now, 50.0, longitude_ += 0.02, 12.0}}, now));
    }
}

TEST_P(StoreSight, FixThatIsHeardLate_CountsAllTheSame) {
    goOn();
    const std::int64_t now = kToday + 1500;
    readFor(now);
    EXPECT_LE(readFor(now), 6U);
    // Two hours ago she was where she was five minutes before: a rest of which nothing had been heard.
    const std::int64_t then = (kToday - 7200) / 300 * 300;
    const auto all = store_->sharing(mara_, ann_)->fixes;
    const auto before = std::find_if(all.rbegin(), all.rend(), [&](const Fix& fix) { return fix.time < then; });
    ASSERT_TRUE(keep({{then + 299, now, before->latitude, before->longitude, 12.0}}, now));
    for (const int later : {0, 300, 600, 900}) {
        readFor(now + later);  // is the same as with all fixes
    }
    EXPECT_LE(readFor(now + 910), 6U) << "and is known from then on";
}

TEST_P(StoreSight, WhoeverIsForgotten_LeavesNothingInTheProcess) {
    goOn();
    const std::int64_t now = kToday + 1500;
    EXPECT_GT(readFor(now), 500U);
    EXPECT_LE(readFor(now), 6U);
    ASSERT_TRUE(store_->forget(otto_, now));
    EXPECT_GT(readFor(now), 500U);
}

TEST_P(StoreSight, ManyHandles_AreAnsweredInTheirOrder) {
    ASSERT_TRUE(keep({{kNow, kNow, 51.0, 8.0, 12.0}}));
    const std::vector<std::string> handles{"nobody@x.example", "ann@x.example", std::string("\0@", 2), "\xff",
                                           "mara@x.example",   "ANN@x.example", "otto@x.example",      ""};
    const auto asked = store_->asked(otto_, handles, kNow);
    ASSERT_TRUE(asked);
    std::vector<std::int64_t> people;
    for (const server::Asked& one : *asked) {
        people.push_back(one.person);
        EXPECT_EQ(Visibility::visible(one.sharing, kNow).has_value(), one.person == ann_);
    }
    EXPECT_EQ(people, (std::vector<std::int64_t>{0, ann_, 0, 0, mara_, ann_, otto_, 0}));
}

}  // namespace ktr::test
