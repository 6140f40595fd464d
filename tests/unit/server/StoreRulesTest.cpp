#include <gtest/gtest.h>

#include <mutex>
#include <set>
#include <string>
#include <vector>

#include "server/store/Store.h"
#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Confirmation;
using server::DeviceKind;
using server::Fix;
using server::Grant;
using server::NamedPlace;
using server::Precision;
using server::Visibility;

class StoreRules : public StoreContract {
  protected:
    static constexpr std::int64_t kDay = 86400;

    static Fix fix(std::int64_t time, double latitude = 50.2) { return {time, time, latitude, -3.1, 12.0}; }
    static NamedPlace home(bool said = true) { return {0, "Home", "home", 50.3, -3.1, 150.0, said}; }
    std::optional<server::Seen> seen(std::int64_t viewer, std::int64_t now = kNow) {
        return Visibility::visible(*store_->sharing(viewer, ann_), now);
    }
    Grant untilHome() {
        EXPECT_TRUE(store_->setPlace(ann_, home()));
        Grant grant;
        grant.from = kNow;
        grant.arrival = store_->placesOf(ann_).front().id;
        return grant;
    }
    bool hides() {
        return finished([&](auto done) { store_->hide(ann_, kNow, done); });
    }
    bool asks(std::int64_t device) {
        return finished([&](auto done) { store_->askToShare(device, done); });
    }
    bool saysNo(std::int64_t device) {
        return finished([&](auto done) { store_->shareAsAsked(device, kNow, done); });
    }
    std::int64_t reader(const char* secret) {
        EXPECT_TRUE(store_->addDevice(ann_, DeviceKind::Reader, secret, "", kNow));
        bool failed = false;
        return store_->deviceOf(secret, failed)->id;
    }
};

TEST_P(StoreRules, RulesForSeveral_AreChangedInOneCommit) {
    std::mutex mutex;
    std::vector<server::Change> heard;
    const auto listening = store_->listen([&](const server::Change& change) {
        const std::lock_guard<std::mutex> lock(mutex);
        if (change.concerns(ann_) && !change.everything) {
            heard.push_back(change);
        }
    });
    const std::vector<std::string> both{"otto@x.example", "nobody@x.example", "Mara@x.example"};
    ASSERT_TRUE(store_->changeRules(ann_, both, {false, kNow + 60, Precision::Town}, kNow));
    for (const auto& [name, rule] : store_->grantsOf(ann_)) {
        EXPECT_EQ(rule.precision, Precision::Town) << name;
        EXPECT_EQ(rule.until, kNow + 60) << name;
    }
    ASSERT_TRUE(store_->changeRules(ann_, both, {true, std::nullopt, std::nullopt}, kNow));
    EXPECT_TRUE(store_->grantsOf(ann_).empty());
    const std::lock_guard<std::mutex> lock(mutex);
    ASSERT_EQ(heard.size(), 2U) << "one for each wish";
    for (const server::Change& change : heard) {
        EXPECT_EQ(change.people, (std::set<std::int64_t>{ann_, otto_, mara_}));
    }
}

TEST_P(StoreRules, Places_AreTheirOwners_ReplacedByNameAndRemoved) {
    ASSERT_TRUE(store_->setPlace(ann_, home(false)));
    ASSERT_TRUE(store_->setPlace(otto_, home()));
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Büro", "work", 50.2, -3.1, 200.0, true}));
    ASSERT_TRUE(store_->setPlace(ann_, home(true)));
    auto places = store_->placesOf(ann_);
    ASSERT_EQ(places.size(), 2U);
    EXPECT_EQ(places[0].name, "Büro");
    const NamedPlace expected{places[1].id, "Home", "home", 50.3, -3.1, 150.0, true};
    EXPECT_EQ(places[1], expected);
    EXPECT_FALSE(store_->removePlace(otto_, places[1].id, kNow)) << "somebody else's";
    EXPECT_TRUE(store_->removePlace(ann_, places[1].id, kNow));
    EXPECT_FALSE(store_->removePlace(ann_, places[1].id, kNow));
    EXPECT_EQ(store_->placesOf(ann_).size(), 1U);
    EXPECT_EQ(store_->placesOf(otto_).size(), 1U);
}

TEST_P(StoreRules, NameOfAPlace_IsHeardAtExactPrecision_WhereItMayBeSaid) {
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Office", "work", 50.2, -3.1, 200.0, true}));
    ASSERT_TRUE(keep({fix(kNow - 10)}));
    EXPECT_EQ(seen(otto_)->place, "Office");
    EXPECT_EQ(seen(otto_)->label, "work");
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Office", "work", 50.2, -3.1, 200.0, false}));
    EXPECT_EQ(seen(otto_)->place, "");
}

TEST_P(StoreRules, GrantUntilArrival_EndsWithTheFixThatLiesThere) {
    ASSERT_TRUE(store_->grant(ann_, mara_, untilHome()));
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->arrival, store_->placesOf(ann_).front().id);
    store_->present(kNow + 10);
    ASSERT_TRUE(keep({fix(kNow + 10)}, kNow + 10));
    EXPECT_TRUE(seen(mara_, kNow + 10));
    // What a phone sends late: it was there in between, and is elsewhere by now.
    store_->present(kNow + 60);
    ASSERT_TRUE(keep({fix(kNow + 20, 50.3), fix(kNow + 50)}, kNow + 60));
    EXPECT_EQ(seen(mara_, kNow + 60), std::nullopt);
    EXPECT_EQ(seen(mara_, kNow + 20), std::nullopt) << "a clock that is set back";
    EXPECT_TRUE(seen(otto_, kNow + 60)) << "another grant stays";
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->until, kNow + 60);
}

TEST_P(StoreRules, GrantUntilArrival_IsNotEnded_ByOldFixes_VagueOnes_OrPlacesOfOthers) {
    Grant grant = untilHome();
    grant.from = kNow + 5;
    ASSERT_TRUE(store_->grant(ann_, mara_, grant));
    Fix vague = fix(kNow + 10, 50.3);
    vague.accuracy = 900.0;
    Fix early = fix(kNow - 30, 50.3);
    early.heard = kNow + 10;
    ASSERT_TRUE(keep({early, vague, fix(kNow + 11)}, kNow + 11));
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->until, std::nullopt);
    // Another person's grant to the same viewer, with a place just there, which is not Ann's affair.
    ASSERT_TRUE(store_->setPlace(otto_, {0, "Work", "work", 50.2, -3.1, 150.0, true}));
    ASSERT_TRUE(store_->grant(otto_, mara_, {Precision::Exact, kNow, std::nullopt, store_->placesOf(otto_)[0].id}));
    ASSERT_TRUE(keep({fix(kNow + 12)}, kNow + 12));
    EXPECT_EQ(store_->sharing(mara_, otto_)->grant->until, std::nullopt);
}

TEST_P(StoreRules, GrantUntilArrival_EndsWhenThePlaceLosesItsName) {
    ASSERT_TRUE(store_->grant(ann_, mara_, untilHome()));
    ASSERT_TRUE(keep({fix(kNow + 1)}, kNow + 1));
    ASSERT_TRUE(seen(mara_, kNow + 1));
    ASSERT_TRUE(store_->removePlace(ann_, store_->placesOf(ann_).front().id, kNow + 2));
    EXPECT_EQ(seen(mara_, kNow + 2), std::nullopt);
}

TEST_P(StoreRules, ArrivalWhileHidden_IsNoticedByNobody) {
    ASSERT_TRUE(store_->grant(ann_, mara_, untilHome()));
    ASSERT_TRUE(hides());
    ASSERT_TRUE(keep({fix(kNow + 10, 50.3)}, kNow + 10));
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->until, std::nullopt);
}

TEST_P(StoreRules, Grants_KeepAllThatTheySay) {
    Grant grant{Precision::Places, kNow, kNow + 500, 0, true, std::nullopt};
    ASSERT_TRUE(store_->grant(ann_, mara_, grant));
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant, grant);
    ASSERT_EQ(store_->grantsOf(ann_).front().first, "mara");
    EXPECT_EQ(store_->grantsOf(ann_).front().second, grant);
    EXPECT_EQ(store_->friendsOf(mara_, kNow).front().sharing.grant, grant);
}

TEST_P(StoreRules, NewGrant_ShowsNothingThatWasHeardBefore_NotInTheSameSecond) {
    ASSERT_TRUE(keep({{kNow + 200, kNow, 50.2, -3.1, 12.0}}));
    ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Exact, kNow, std::nullopt}));
    EXPECT_EQ(seen(mara_), std::nullopt);
    EXPECT_EQ(seen(mara_, kNow + 500), std::nullopt);
    ASSERT_TRUE(keep({fix(kNow + 501)}, kNow + 501));
    EXPECT_TRUE(seen(mara_, kNow + 501));
}

TEST_P(StoreRules, ChangedGrant_GoesOnForWhoSawAsExactly_AndBeginsAnewForOthers) {
    store_->present(kNow);
    ASSERT_TRUE(keep({fix(kNow - 10)}));
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Kilometre, kNow, kNow + 900}));
    EXPECT_EQ(store_->sharing(otto_, ann_)->grant->from, kNow - 1000) << "saw exactly until now";
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Places, kNow, std::nullopt}));
    EXPECT_GT(store_->sharing(otto_, ann_)->grant->from, kNow - 10) << "places say more than cells";
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, kNow + 50, kNow + 100}));
    EXPECT_EQ(store_->sharing(otto_, ann_)->grant->from, kNow + 50);
    store_->present(kNow + 100);
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Town, kNow + 100, std::nullopt}));
    EXPECT_EQ(store_->sharing(otto_, ann_)->grant->from, kNow + 100) << "was over";
}

TEST_P(StoreRules, Question_IsAnsweredOnce_AndNotWhenItIsTooLate) {
    ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Exact, kNow, std::nullopt}));
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, kNow, kNow + 400 * kDay}));
    const std::int64_t asked = kNow + 90 * kDay;
    EXPECT_EQ(store_->confirmGrant(ann_, mara_, asked), Confirmation::Kept);
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->end(), asked + 97 * kDay);
    EXPECT_EQ(store_->confirmGrant(ann_, otto_, asked), Confirmation::HasAnEnd);
    EXPECT_EQ(store_->confirmGrant(otto_, mara_, asked), Confirmation::IsNotThere);
    EXPECT_EQ(store_->confirmGrant(ann_, mara_, asked + 97 * kDay), Confirmation::IsNotThere);
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->end(), asked + 97 * kDay) << "nothing begins again by itself";
    // By the highest time of all, also with a clock that was set back.
    EXPECT_EQ(store_->confirmGrant(ann_, mara_, asked), Confirmation::IsNotThere);
}

TEST_P(StoreRules, ChangedGrant_IsAskedAbout90DaysAfterTheChange) {
    ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Exact, kNow, std::nullopt}));
    store_->present(kNow + 50 * kDay);
    ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Town, kNow + 50 * kDay, std::nullopt}));
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->from, kNow);
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant->end(), kNow + 147 * kDay);
}

TEST_P(StoreRules, No_SharesOnlyIfThatDeviceAsked_AfterTheNewestHidingFromAnywhere) {
    const auto hidden = [&] { return store_->person(ann_)->hidden; };
    const std::int64_t desk = reader("desk");
    const std::int64_t sofa = reader("sofa");
    ASSERT_TRUE(hides());
    ASSERT_TRUE(saysNo(desk));
    EXPECT_TRUE(hidden()) << "nobody asked";
    ASSERT_TRUE(asks(desk));
    EXPECT_TRUE(hidden()) << "asking alone shows nobody";
    ASSERT_TRUE(saysNo(sofa));
    EXPECT_TRUE(hidden()) << "another device asked";
    ASSERT_TRUE(saysNo(desk));
    EXPECT_FALSE(hidden());
    // Elsewhere: by a command, by the administration, by another reader.
    ASSERT_TRUE(hides());
    ASSERT_TRUE(saysNo(desk));
    EXPECT_TRUE(hidden()) << "it asked before that hiding";
    ASSERT_TRUE(asks(desk));
    ASSERT_TRUE(store_->setHidden(ann_, true, kNow));
    ASSERT_TRUE(saysNo(desk));
    EXPECT_TRUE(hidden());
    ASSERT_TRUE(asks(desk));
    ASSERT_TRUE(store_->revokeDevice(ann_, desk, kNow));
    ASSERT_TRUE(saysNo(desk));
    EXPECT_TRUE(hidden()) << "what a revoked device began ends with it";
    ASSERT_TRUE(asks(desk));
    ASSERT_TRUE(saysNo(desk));
    EXPECT_TRUE(hidden());
}

TEST_P(StoreRules, Showing_ShowsNothingFromBefore_NotWithAClockThatIsSetBack) {
    ASSERT_TRUE(keep({fix(kNow)}));
    ASSERT_TRUE(hides());
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow));
    EXPECT_EQ(seen(otto_), std::nullopt) << "in the same second";
    ASSERT_TRUE(hides());
    store_->present(kNow + 100);
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow - 5000));
    EXPECT_EQ(store_->sharing(otto_, ann_)->shownSince, kNow + 100);
    EXPECT_EQ(seen(otto_), std::nullopt);
}

TEST_P(StoreRules, Devices_AreRevokedOneByOne) {
    const std::int64_t desk = reader("desk");
    ASSERT_TRUE(store_->addDevice(ann_, DeviceKind::Phone, "child's", "", kNow + 1, true));
    ASSERT_TRUE(keep({}, kNow + 3));
    ASSERT_TRUE(store_->revokeDevice(ann_, desk, kNow + 5));
    EXPECT_FALSE(store_->revokeDevice(ann_, desk, kNow + 6)) << "once";
    EXPECT_FALSE(store_->revokeDevice(otto_, phone_, kNow)) << "somebody else's";
    bool failed = false;
    EXPECT_EQ(store_->deviceOf("desk", failed), std::nullopt);
    EXPECT_TRUE(store_->deviceOf("ann's", failed));
    EXPECT_FALSE(store_->deviceOf("ann's", failed)->shared);
    EXPECT_TRUE(store_->deviceOf("child's", failed)->shared);
    const auto devices = store_->devicesOf(ann_);
    ASSERT_EQ(devices.size(), 3U);
    EXPECT_EQ(devices[2].made, kNow + 1);
    EXPECT_TRUE(devices[2].shared);
    for (const server::DeviceFacts& device : devices) {
        EXPECT_EQ(device.revoked, device.id == desk ? std::optional(kNow + 5) : std::nullopt);
        EXPECT_EQ(device.heard, device.id == phone_ ? std::optional(kNow + 3) : std::nullopt);
        EXPECT_EQ(device.kind, device.id == desk ? DeviceKind::Reader : DeviceKind::Phone);
    }
}

TEST_P(StoreRules, WhatARevokedPhoneStillSends_IsNotKept) {
    ASSERT_TRUE(store_->revokeDevice(ann_, phone_, kNow));
    ASSERT_TRUE(keep({fix(kNow)}));
    EXPECT_TRUE(seenByOtto().empty()) << "it was let in before its secret ended";
    EXPECT_EQ(store_->lastHeard(ann_), std::nullopt);
}

TEST_P(StoreRules, Looks_AreReadByTheHour_AskedApartFromCarriedAlong) {
    const auto note = [&](std::int64_t viewer, bool asked, std::int64_t now) {
        ASSERT_TRUE(finished([&](auto done) { store_->noteLooks(viewer, {ann_}, asked, now, done); }));
    };
    const std::int64_t hour = kNow / 3600 * 3600;
    note(otto_, false, hour + 10);
    note(otto_, false, hour + 20);
    note(mara_, true, hour + 30);
    note(mara_, false, hour + 40);
    note(otto_, true, hour - 10);
    const auto looks = store_->looksAt(ann_);
    ASSERT_EQ(looks.size(), 3U) << "one a viewer and hour";
    EXPECT_EQ(looks[0].viewer + std::to_string(looks[0].hour) + (looks[0].asked ? "!" : ""),
              "mara" + std::to_string(hour) + "!");
    EXPECT_EQ(looks[1].viewer + std::to_string(looks[1].hour) + (looks[1].asked ? "!" : ""),
              "otto" + std::to_string(hour));
    EXPECT_EQ(looks[2].viewer + std::to_string(looks[2].hour) + (looks[2].asked ? "!" : ""),
              "otto" + std::to_string(hour - 3600) + "!");
    EXPECT_TRUE(store_->looksAt(otto_).empty());
}

TEST_P(StoreRules, AskedHandles_GiveWhatIsSeenOfEach_WhoeverTheyAre) {
    ASSERT_TRUE(keep({fix(kNow - 20), fix(kNow - 10, 50.3)}));
    const auto asked =
        store_->asked(otto_, {"nobody@x.example", "ANN@x.example", "mara@x.example", "ann@x.example"}, kNow);
    ASSERT_TRUE(asked);
    ASSERT_EQ(asked->size(), 4U);
    EXPECT_EQ((*asked)[0].person, 0);
    EXPECT_EQ((*asked)[2].person, mara_);
    EXPECT_EQ((*asked)[2].sharing.grant, std::nullopt);
    for (const std::size_t ann : {std::size_t{1}, std::size_t{3}}) {
        EXPECT_EQ((*asked)[ann].person, ann_);
        EXPECT_EQ(Visibility::visible((*asked)[ann].sharing, kNow), seen(otto_));
        EXPECT_EQ((*asked)[ann].sharing.fixes.size(), 1U) << "no more than is seen";
    }
    EXPECT_EQ(Visibility::visible(store_->friendsOf(otto_, kNow).at(0).sharing, kNow), seen(otto_));
}

TEST_P(StoreRules, HandlesThatAreNoText_AreNobodys_AndHideNobodyElse) {
    ASSERT_TRUE(keep({fix(kNow - 10)}));
    const std::string zero("a\0@x.example", 12);
    const auto asked = store_->asked(otto_, {zero, "\xff@x.example", "\xff", "ann@x.example"}, kNow);
    ASSERT_TRUE(asked);
    EXPECT_EQ((*asked)[0].person, 0);
    EXPECT_EQ((*asked)[1].person, 0);
    EXPECT_EQ((*asked)[2].person, 0);
    EXPECT_EQ((*asked)[3].person, ann_);
    EXPECT_TRUE(Visibility::visible((*asked)[3].sharing, kNow));
    EXPECT_EQ(store_->personOf(zero), std::nullopt);
    EXPECT_FALSE(store_->personNamed(zero));
    EXPECT_EQ(store_->readFailures(), 0U);
}

TEST_P(StoreRules, NewestFix_IsTheNewestOfThoseHeardSinceTheShowing) {
    // By a clock that is ahead, before the hiding; then by one that was put right.
    ASSERT_TRUE(keep({{kNow + 250, kNow, 50.2, -3.1, 12.0}}));
    ASSERT_TRUE(hides());
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow + 100));
    ASSERT_TRUE(keep({{kNow + 110, kNow + 110, 50.3, -3.1, 12.0}}, kNow + 110));
    const auto asked = store_->asked(otto_, {"ann@x.example"}, kNow + 300);
    ASSERT_TRUE(asked);
    const auto what = Visibility::visible(asked->at(0).sharing, kNow + 300);
    ASSERT_TRUE(what);
    EXPECT_EQ(what->latitude, 50.3);
    EXPECT_EQ(what, seen(otto_, kNow + 300));
}

TEST_P(StoreRules, CoarseGrant_ReadsTheLastSlots_NotTwoDaysOfMinutes) {
    ASSERT_TRUE(store_->addPerson("kim", {}, kNow));
    const std::int64_t kim = store_->personNamed("kim")->id;
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Field", "", 50.3, -3.1, 500.0, true}));
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Kilometre, kNow - 2 * kDay, std::nullopt}));
    ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Town, kNow - 2 * kDay, std::nullopt}));
    ASSERT_TRUE(store_->grant(ann_, kim, {Precision::Places, kNow - 2 * kDay, std::nullopt}));
    std::vector<Fix> fixes;
    for (std::int64_t time = kNow - 2 * kDay + 3600; time < kNow; time += 60) {
        fixes.push_back(fix(time, time < kNow - 600 ? 50.2 : 50.3));
    }
    ASSERT_TRUE(keep(fixes));
    for (const std::int64_t viewer : {otto_, mara_, kim}) {
        const auto asked = store_->asked(viewer, {"ann@x.example"}, kNow);
        ASSERT_TRUE(asked);
        EXPECT_LE(asked->at(0).sharing.fixes.size(), 4U);
        ASSERT_TRUE(seen(viewer));
        EXPECT_EQ(Visibility::visible(asked->at(0).sharing, kNow), seen(viewer));
    }
}

TEST_P(StoreRules, EndedGrant_ReadsNothing) {
    ASSERT_TRUE(keep({fix(kNow - 20)}));
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, kNow - 1000, kNow + 5}));
    store_->present(kNow + 5);
    EXPECT_TRUE(store_->asked(otto_, {"ann@x.example"}, kNow)->at(0).sharing.fixes.empty());
    EXPECT_TRUE(store_->friendsOf(otto_, kNow).at(0).sharing.fixes.empty());
}

TEST_P(StoreRules, Zone_IsKept) {
    EXPECT_EQ(store_->person(ann_)->zone, "");
    ASSERT_TRUE(store_->setZone(ann_, "Asia/Tokyo"));
    EXPECT_EQ(store_->person(ann_)->zone, "Asia/Tokyo");
    EXPECT_EQ(store_->people().front().zone, "Asia/Tokyo");
}

TEST_P(StoreRules, NewestFix_IsTheOneWithTheGreatestTime) {
    EXPECT_EQ(store_->newestFix(ann_), std::nullopt);
    ASSERT_TRUE(keep({at(kNow - 10, 51.0), at(kNow - 30), at(kNow - 20)}));
    EXPECT_EQ(store_->newestFix(ann_), at(kNow - 10, 51.0));
    EXPECT_EQ(store_->newestFix(otto_), std::nullopt);
}

TEST_P(StoreRules, PlacesOfAPhone_AreKeptUnsaidAndMovedButNotSaidAnew) {
    const auto keepPlaces = [&](std::vector<NamedPlace> places) {
        return finished([&](auto done) { store_->keepPlaces(ann_, std::move(places), done); });
    };
    EXPECT_TRUE(keepPlaces({{0, "Pool", "", 50.4, -3.1, 200.0, true}}));
    ASSERT_EQ(store_->placesOf(ann_).size(), 1U);
    EXPECT_FALSE(store_->placesOf(ann_).front().said) << "only its owner says that";
    NamedPlace said = store_->placesOf(ann_).front();
    said.said = true;
    said.label = "gym";
    EXPECT_TRUE(store_->setPlace(ann_, said));
    EXPECT_TRUE(keepPlaces({{0, "Pool", "", 50.5, -3.2, 300.0, false}}));
    ASSERT_EQ(store_->placesOf(ann_).size(), 1U);
    said.latitude = 50.5;
    said.longitude = -3.2;
    said.radius = 300.0;
    EXPECT_EQ(store_->placesOf(ann_).front(), said);
    EXPECT_TRUE(store_->placesOf(otto_).empty());
}

TEST_P(StoreRules, PlacesOfAPhone_AreAHundredAtMost) {
    std::vector<NamedPlace> many;
    for (int number = 0; number < NamedPlace::kMost + 20; ++number) {
        many.push_back({0, "Place " + std::to_string(1000 + number), "", 50.4, -3.1, 200.0, false});
    }
    EXPECT_TRUE(finished([&](auto done) { store_->keepPlaces(ann_, many, done); }));
    EXPECT_EQ(store_->placesOf(ann_).size(), std::size_t{NamedPlace::kMost});
    many.front().latitude = 51.0;
    EXPECT_TRUE(finished([&](auto done) { store_->keepPlaces(ann_, {many.front()}, done); }));
    EXPECT_EQ(store_->placesOf(ann_).front().latitude, 51.0) << "those that are there still move";
}

TEST_P(StoreRules, APlace_IsChangedByItsOwnerAndKeepsWhatRefersToIt) {
    const Grant grant = untilHome();
    ASSERT_TRUE(store_->setPlace(ann_, {0, "Pool", "", 50.4, -3.1, 200.0, false}));
    NamedPlace place = store_->placesOf(ann_).front();
    ASSERT_EQ(place.id, grant.arrival);
    place.name = "Cottage";
    place.said = false;
    EXPECT_FALSE(store_->changePlace(otto_, place));
    EXPECT_TRUE(store_->changePlace(ann_, place));
    EXPECT_EQ(store_->placesOf(ann_).front(), place);
    place.name = "Pool";
    EXPECT_FALSE(store_->changePlace(ann_, place)) << "another one has that name";
    EXPECT_EQ(store_->placesOf(ann_).front().name, "Cottage");
    place.id += 1;
    EXPECT_FALSE(store_->changePlace(ann_, place));
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreRules, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreRules, ::testing::Values(true));

}  // namespace ktr::test
