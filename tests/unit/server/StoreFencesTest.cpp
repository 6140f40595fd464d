#include <gtest/gtest.h>

#include "server/store/Store.h"
#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::DeviceKind;
using server::Fence;
using server::FenceCircle;
using server::FenceEvent;
using server::FenceOutcome;
using server::FencePlace;
using server::FenceWish;
using server::Fix;
using server::Grant;
using server::NamedPlace;
using server::Precision;

/// Ann's fixes cross what Otto set; his reader is told.
class StoreFences : public StoreContract {
  protected:
    static constexpr double kDegree = 111230.0;

    void SetUp() override {
        StoreContract::SetUp();
        if (IsSkipped() || HasFatalFailure()) {
            return;
        }
        ASSERT_TRUE(store_->addDevice(otto_, DeviceKind::Reader, "otto's", "", kNow));
        bool failed = false;
        reader_ = store_->deviceOf("otto's", failed)->id;
        ASSERT_TRUE(letTell(otto_));
    }
    bool letTell(std::int64_t viewer, Precision precision = Precision::Exact, bool fences = true) {
        Grant grant{precision, kNow - 1000, std::nullopt};
        grant.fences = fences;
        return store_->grant(ann_, viewer, grant);
    }
    FenceOutcome set(const FenceWish& wish, std::int64_t now = kNow) {
        std::promise<FenceOutcome> outcome;
        store_->setFence(wish, now, [&](FenceOutcome what, const Fence& fence) {
            kept_ = fence;
            outcome.set_value(what);
        });
        return outcome.get_future().get();
    }
    static FencePlace circle(double radius = 150.0) { return {"", FenceCircle{50.2, -3.1, radius}}; }
    FenceWish wish(bool arrives, bool once = false) const { return {otto_, ann_, circle(), arrives, once}; }
    /// Ann is so many metres north of the centre.
    bool isAt(std::int64_t time, double metres, double accuracy = 10.0) {
        store_->present(time);
        return keep({{time, time, 50.2 + metres / kDegree, -3.1, accuracy}}, time);
    }
    std::vector<FenceEvent> told(std::int64_t now = kNow, std::int64_t after = 0) {
        return store_->eventsFor(reader_, after, now, 100).value();
    }
    std::string toldInShort(std::int64_t now = kNow) {
        std::string text;
        for (const FenceEvent& event : told(now)) {
            text += (event.arrives ? "+" : "-") + std::to_string(event.time - kNow) + " ";
        }
        return text;
    }

    std::int64_t reader_ = 0;
    Fence kept_;
};

TEST_P(StoreFences, WhoGoes_IsTold_OnceAndInOrder) {
    ASSERT_TRUE(isAt(kNow, 0.0));
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_EQ(set(wish(true)), FenceOutcome::Set);
    EXPECT_EQ(toldInShort(), "") << "it begins on the side where she is";
    ASSERT_TRUE(isAt(kNow + 100, 800.0));
    EXPECT_EQ(toldInShort(), "");
    ASSERT_TRUE(isAt(kNow + 200, 900.0));
    ASSERT_TRUE(isAt(kNow + 300, 20.0));
    ASSERT_TRUE(isAt(kNow + 400, 20.0));
    EXPECT_EQ(toldInShort(kNow + 400), "-100 +300 ");
    const auto events = told(kNow + 400);
    EXPECT_EQ(events[0].number, 1);
    EXPECT_EQ(events[1].number, 2);
    EXPECT_EQ(events[0].name, "ann");
    EXPECT_EQ(events[0].handle, "ann@x.example");
    EXPECT_EQ(told(kNow + 400, 1).size(), 1U);
}

TEST_P(StoreFences, Events_OutliveARestart_AndAreToldNoMoreThanOnce) {
    ASSERT_TRUE(isAt(kNow, 900.0));
    ASSERT_TRUE(isAt(kNow + 60, 900.0));
    ASSERT_EQ(set(wish(true)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 100, 0.0));
    open();
    ASSERT_EQ(told(kNow + 100).size(), 1U);
    ASSERT_TRUE(finished([&](auto done) { store_->acknowledgeEvents(reader_, 1, done); }));
    EXPECT_TRUE(told(kNow + 100).empty());
    ASSERT_TRUE(isAt(kNow + 200, 900.0));
    ASSERT_TRUE(isAt(kNow + 300, 900.0));
    open();
    ASSERT_TRUE(isAt(kNow + 400, 0.0));
    ASSERT_EQ(told(kNow + 400).size(), 1U);
    EXPECT_EQ(told(kNow + 400)[0].number, 2) << "a number never comes again";
}

TEST_P(StoreFences, HalfOfACrossing_OutlivesARestart) {
    ASSERT_TRUE(isAt(kNow, 0.0));
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 100, 800.0));
    open();
    ASSERT_TRUE(isAt(kNow + 200, 900.0));
    EXPECT_EQ(toldInShort(kNow + 200), "-100 ");
}

TEST_P(StoreFences, OnceIsOnce) {
    ASSERT_TRUE(isAt(kNow, 0.0));
    ASSERT_EQ(set(wish(false, true)), FenceOutcome::Set);
    EXPECT_EQ(store_->fencesBy(otto_)->size(), 1U);
    for (int i = 1; i < 5; ++i) {
        ASSERT_TRUE(isAt(kNow + i * 100L, i % 2 == 1 ? 900.0 : 0.0));
        ASSERT_TRUE(isAt(kNow + i * 100L + 50, i % 2 == 1 ? 900.0 : 0.0));
    }
    EXPECT_EQ(toldInShort(kNow + 500), "-100 ");
    EXPECT_TRUE(store_->fencesBy(otto_)->empty());
    EXPECT_TRUE(store_->fencesAbout(ann_)->empty());
}

TEST_P(StoreFences, Refusals_AreAlikeForWhoeverDoesNotLetTell) {
    ASSERT_TRUE(isAt(kNow, 0.0));
    const auto asked = [&](std::int64_t watcher, std::int64_t subject) {
        return set({watcher, subject, circle(), true, true});
    };
    EXPECT_EQ(asked(otto_, 0), FenceOutcome::Refused) << "nobody";
    EXPECT_EQ(asked(otto_, mara_), FenceOutcome::Refused) << "a stranger";
    EXPECT_EQ(asked(otto_, otto_), FenceOutcome::Refused) << "himself";
    ASSERT_TRUE(letTell(mara_, Precision::Exact, false));
    EXPECT_EQ(asked(mara_, ann_), FenceOutcome::Refused) << "without leave";
    ASSERT_TRUE(letTell(mara_, Precision::Kilometre));
    EXPECT_EQ(asked(mara_, ann_), FenceOutcome::Refused) << "not exactly";
    ASSERT_TRUE(store_->setHidden(ann_, true, kNow));
    EXPECT_EQ(asked(otto_, ann_), FenceOutcome::Refused) << "hidden";
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow));
    EXPECT_EQ(asked(otto_, ann_), FenceOutcome::Set);
    store_->present(kNow + 100L * 86400);
    EXPECT_EQ(asked(otto_, ann_), FenceOutcome::Refused) << "over";
}

TEST_P(StoreFences, TenOfAPair_AndTheSameOneOnce) {
    for (int i = 0; i < 10; ++i) {
        EXPECT_EQ(set({otto_, ann_, circle(150.0 + i), true, true}), FenceOutcome::Set);
    }
    const auto last = kept_;
    EXPECT_EQ(set({otto_, ann_, circle(159.0), true, true}), FenceOutcome::Set) << "it is there";
    EXPECT_EQ(kept_, last);
    EXPECT_EQ(set({otto_, ann_, circle(300.0), true, true}), FenceOutcome::TooMany);
    EXPECT_EQ(store_->fencesBy(otto_)->size(), 10U);
    ASSERT_TRUE(letTell(mara_));
    EXPECT_EQ(set({mara_, ann_, circle(300.0), true, true}), FenceOutcome::Set) << "of each pair";
}

TEST_P(StoreFences, Circle_IsNoSmallerThanAPhoneCanTell) {
    EXPECT_EQ(set({otto_, ann_, circle(10.0), true, true}), FenceOutcome::Set);
    EXPECT_EQ(kept_.circle.radius, 100.0);
    EXPECT_EQ(set({otto_, ann_, circle(90000.0), true, true}), FenceOutcome::Set);
    EXPECT_EQ(kept_.circle.radius, 5000.0);
}

TEST_P(StoreFences, Place_IsTheOwnersIfItMayBeSaid_OrWhereTheyAreSeen) {
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Office", "work", 50.2, -3.1, 200.0, true}));
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Club", "gym", 50.3, -3.1, 150.0, false}));
    const auto called = [&](const char* name) { return set({otto_, ann_, {name, std::nullopt}, false, true}); };
    EXPECT_EQ(called("work"), FenceOutcome::Set);
    EXPECT_EQ(kept_.name, "Office");
    EXPECT_EQ(kept_.label, "work");
    EXPECT_EQ(kept_.circle, (FenceCircle{50.2, -3.1, 200.0}));
    EXPECT_EQ(called("Office"), FenceOutcome::Set);
    EXPECT_EQ(called("Club"), FenceOutcome::NoPlace) << "it may not be said";
    EXPECT_EQ(called("gym"), FenceOutcome::NoPlace);
    EXPECT_EQ(called("Nowhere"), FenceOutcome::NoPlace);
    EXPECT_EQ(called(""), FenceOutcome::NoPlace) << "nobody knows where she is";
    ASSERT_TRUE(isAt(kNow, 5000.0));
    EXPECT_EQ(called(""), FenceOutcome::Set);
    EXPECT_EQ(kept_.name, "");
    EXPECT_NEAR(kept_.circle.latitude, 50.2 + 5000.0 / kDegree, 1e-9);
    EXPECT_EQ(kept_.circle.radius, FenceCircle::kAdvisedRadius);
    ASSERT_TRUE(isAt(kNow + 10, 10.0));
    EXPECT_EQ(called(""), FenceOutcome::Set);
    EXPECT_EQ(kept_.name, "Office");
}

TEST_P(StoreFences, EndedGrant_EndsThem_WithWhatTheyHaveNotTold) {
    const auto begin = [&] {
        ASSERT_TRUE(letTell(otto_));
        ASSERT_TRUE(isAt(kNow, 0.0));
        ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
        static std::int64_t time = kNow + 1000;
        ASSERT_TRUE(isAt(time += 100, 900.0));
        ASSERT_TRUE(isAt(time += 100, 900.0));
        ASSERT_TRUE(isAt(time += 100, 0.0));
        ASSERT_FALSE(told(time).empty());
    };
    const auto isOver = [&](const char* why) {
        EXPECT_TRUE(told(kNow).empty()) << why;
        ASSERT_TRUE(letTell(otto_));
        EXPECT_TRUE(told(kNow).empty()) << why << ", then or later";
        EXPECT_TRUE(store_->fencesBy(otto_)->empty()) << why;
    };
    begin();
    EXPECT_TRUE(store_->revokeGrant(ann_, otto_));
    isOver("revoked");
    begin();
    EXPECT_TRUE(store_->changeRules(ann_, {"OTTO@x.example"}, {true, std::nullopt, std::nullopt}, kNow));
    isOver("revoked by handle");
    begin();
    EXPECT_TRUE(letTell(otto_, Precision::Town));
    isOver("less exact");
    begin();
    EXPECT_TRUE(letTell(otto_, Precision::Exact, false));
    isOver("leave taken back");
    begin();
    EXPECT_TRUE(finished([&](auto done) { store_->hide(ann_, kNow, done); }));
    EXPECT_TRUE(store_->setHidden(ann_, false, kNow));
    isOver("hidden");
}

TEST_P(StoreFences, GrantThatEndsOnArrival_EndsThemThere) {
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Home", "home", 50.3, -3.1, 150.0, true}));
    Grant grant{Precision::Exact, kNow, std::nullopt};
    grant.arrival = store_->placesOf(ann_).front().id;
    grant.fences = true;
    ASSERT_TRUE(store_->grant(ann_, otto_, grant));
    ASSERT_EQ(set({otto_, ann_, {"home", std::nullopt}, true, false}), FenceOutcome::Set);
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 10, 0.0));
    ASSERT_TRUE(isAt(kNow + 20, 0.1 * kDegree));
    EXPECT_TRUE(told(kNow + 20).empty());
    EXPECT_TRUE(store_->fencesBy(otto_)->empty());
    ASSERT_TRUE(store_->grant(ann_, otto_, grant));
    store_->present(kNow + 30);
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_TRUE(store_->removePlace(ann_, grant.arrival, kNow + 30));
    EXPECT_TRUE(store_->fencesAbout(ann_)->empty()) << "a place that is gone ends the grant";
}

TEST_P(StoreFences, GrantThatTimeEnds_TellsNothingMore) {
    Grant grant{Precision::Exact, kNow - 1000, kNow + 1000};
    grant.fences = true;
    ASSERT_TRUE(store_->grant(ann_, otto_, grant));
    ASSERT_TRUE(isAt(kNow, 0.0));
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 100, 900.0));
    ASSERT_TRUE(isAt(kNow + 200, 900.0));
    ASSERT_EQ(told(kNow + 200).size(), 1U);
    store_->present(kNow + 1000);
    EXPECT_TRUE(told(kNow + 200).empty());
    EXPECT_TRUE(store_->fencesBy(otto_)->empty());
    ASSERT_TRUE(isAt(kNow + 1100, 0.0));
    ASSERT_TRUE(letTell(otto_));
    EXPECT_TRUE(store_->fencesBy(otto_)->empty()) << "the next fix took it away";
}

TEST_P(StoreFences, WhatIsPostedWhileHidden_FiresNothing_ThenOrLater) {
    ASSERT_TRUE(isAt(kNow, 0.0));
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_TRUE(store_->setHidden(ann_, true, kNow + 1));
    ASSERT_TRUE(isAt(kNow + 100, 900.0));
    ASSERT_TRUE(isAt(kNow + 200, 900.0));
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow + 300));
    ASSERT_EQ(set(wish(true)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 400, 900.0));
    ASSERT_TRUE(isAt(kNow + 500, 900.0));
    EXPECT_EQ(toldInShort(kNow + 500), "") << "where she was before counts for nothing";
    ASSERT_TRUE(isAt(kNow + 600, 0.0));
    EXPECT_EQ(toldInShort(kNow + 600), "+600 ");
}

TEST_P(StoreFences, LatePosts_TellWhenItWas_OrNothingAfterSixHours) {
    ASSERT_TRUE(isAt(kNow, 0.0));
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_EQ(set(wish(true)), FenceOutcome::Set);
    const std::int64_t heard = kNow + 7L * 3600;
    const auto fix = [&](std::int64_t time, double metres) {
        return Fix{time, heard, 50.2 + metres / kDegree, -3.1, 10.0};
    };
    const auto before = store_->droppedEvents();
    store_->present(heard);
    ASSERT_TRUE(keep({fix(kNow + 100, 900.0), fix(kNow + 200, 900.0), fix(kNow + 6L * 3600, 0.0)}, heard));
    EXPECT_EQ(toldInShort(heard), "+21600 ");
    EXPECT_EQ(store_->droppedEvents(), before + 1);
}

TEST_P(StoreFences, WhatNobodyHeardInTime_IsDroppedAndCounted) {
    ASSERT_TRUE(isAt(kNow, 900.0));
    ASSERT_TRUE(isAt(kNow + 60, 900.0));
    ASSERT_EQ(set(wish(true)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 100, 0.0));
    const std::int64_t later = kNow + 100 + FenceEvent::kLasts;
    EXPECT_EQ(told(later - 1).size(), 1U);
    EXPECT_TRUE(told(later).empty());
    const auto before = store_->droppedEvents();
    ASSERT_TRUE(finished([&](auto done) { store_->deleteOld(later, done); }));
    EXPECT_EQ(store_->droppedEvents(), before + 1);
    EXPECT_TRUE(told(later - 1).empty());
}

TEST_P(StoreFences, OneWhoIsWatched_SeesAndEndsThem_StrangersDoNot) {
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    const auto about = *store_->fencesAbout(ann_);
    ASSERT_EQ(about.size(), 1U);
    EXPECT_EQ(about[0].other, "otto");
    EXPECT_EQ(about[0].handle, "otto@x.example");
    EXPECT_EQ(about[0].fence.made, kNow);
    EXPECT_EQ(store_->fencesBy(otto_)->at(0).other, "ann");
    EXPECT_EQ(store_->endFence(mara_, about[0].fence.id), FenceOutcome::Refused);
    EXPECT_EQ(store_->endFence(ann_, about[0].fence.id), FenceOutcome::Set);
    EXPECT_EQ(store_->endFence(ann_, about[0].fence.id), FenceOutcome::Refused);
    EXPECT_TRUE(store_->fencesBy(otto_)->empty());
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    EXPECT_EQ(store_->endFence(otto_, kept_.id), FenceOutcome::Set);
}

TEST_P(StoreFences, RevokedReader_IsToldNothing) {
    ASSERT_TRUE(isAt(kNow, 0.0));
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 100, 900.0));
    ASSERT_TRUE(isAt(kNow + 200, 900.0));
    ASSERT_EQ(told(kNow + 200).size(), 1U);
    ASSERT_TRUE(store_->revokeDevice(otto_, reader_, kNow + 200));
    EXPECT_TRUE(told(kNow + 200).empty());
}

TEST_P(StoreFences, Fence_KeepsNoPlaceOfTheWatchedPerson) {
    ASSERT_TRUE(isAt(kNow, 12345.0));
    ASSERT_EQ(set(wish(false)), FenceOutcome::Set);
    ASSERT_TRUE(isAt(kNow + 100, 12400.0));
    ASSERT_TRUE(store_->setRetention(ann_, {3600, 86400}, kNow + 50000));
    const auto all = store_->everythingOf(ann_);
    ASSERT_TRUE(all);
    EXPECT_TRUE(all->find("fix")->array()->empty());
    ASSERT_EQ(all->find("fence")->array()->size(), 1U);
    EXPECT_EQ(all->find("fence")->array()->front().dictionary()->find("latitude")->number(), 50.2);
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreFences, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreFences, ::testing::Values(true));

}  // namespace ktr::test
