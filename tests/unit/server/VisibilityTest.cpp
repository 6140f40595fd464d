#include "server/rules/Visibility.h"

#include <gtest/gtest.h>

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>
#include <random>
#include <set>

#include "server/rules/Cell.h"

namespace ktr::test {

using server::Cell;
using server::Fix;
using server::Grant;
using server::NamedPlace;
using server::Precision;
using server::Seen;
using server::Sharing;
using server::Visibility;

class CellTest : public ::testing::Test {
  protected:
    static double metres(double latitude, double longitude, const Cell::Place& place) {
        double distance = 0.0;
        GeographicLib::Geodesic::WGS84().Inverse(latitude, longitude, place.latitude, place.longitude, distance);
        return distance;
    }
};

TEST_F(CellTest, Place_LiesWithinTheRadius_AndItsCentreInItsCell) {
    std::mt19937 random(1);
    std::uniform_real_distribution<double> latitudes(-90.0, 90.0);
    std::uniform_real_distribution<double> longitudes(-180.0, 180.0);
    for (int i = 0; i < 20000; ++i) {
        // A third of them near the poles.
        const double latitude =
            i % 3 == 0 ? std::copysign(90.0 - std::abs(latitudes(random)) / 900.0, i % 2 - 0.5) : latitudes(random);
        const double longitude = longitudes(random);
        for (const double side : {1000.0, 4000.0}) {
            const Cell cell = Cell::of(latitude, longitude, side);
            const auto place = cell.place(side);
            EXPECT_EQ(Cell::of(place.latitude, place.longitude, side), cell) << latitude << " " << longitude;
            // The grid is on a sphere; the earth differs by half a percent.
            EXPECT_LE(metres(latitude, longitude, place), place.radius * 1.01) << latitude << " " << longitude;
            EXPECT_GE(place.radius, side / 2.0);
            EXPECT_LE(place.radius, 2.0 * side);
        }
    }
}

TEST_F(CellTest, EastEndAndWestEnd_AreOne) {
    EXPECT_EQ(Cell::of(50.0, 180.0, 4000.0), Cell::of(50.0, -180.0, 4000.0));
    EXPECT_EQ(Cell::of(90.0, 10.0, 4000.0).column, 0);
    EXPECT_EQ(Cell::of(-90.0, 10.0, 4000.0).column, 0);
}

class VisibilityTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760300;  // a third into a town slot
    static constexpr std::int64_t kDay = 86400;

    static Sharing shared(Precision precision) {
        Sharing sharing;
        sharing.retention = 2 * kDay;
        sharing.grant = Grant{precision, kNow - kDay, std::nullopt};
        return sharing;
    }
    static Fix fix(std::int64_t time, double latitude, double longitude) {
        return {time, time, latitude, longitude, 12.0};
    }
};

TEST_F(VisibilityTest, Exact_IsTheFixWithTheGreatestTime) {
    Sharing sharing = shared(Precision::Exact);
    sharing.fixes = {fix(kNow - 600, 50.0, -3.0), fix(kNow - 60, 50.2, -3.1)};
    sharing.fixes[0].heard = kNow;
    EXPECT_EQ(Visibility::visible(sharing, kNow), (Seen{50.2, -3.1, 12.0, kNow - 60, "", "", true}));
}

TEST_F(VisibilityTest, NothingIsSeen_OfWhoIsStrangeHiddenExpiredOrSilent) {
    Sharing good = shared(Precision::Exact);
    good.fixes = {fix(kNow - 60, 50.2, -3.1)};
    ASSERT_TRUE(Visibility::visible(good, kNow));
    Sharing other = good;
    other.grant.reset();
    EXPECT_EQ(Visibility::visible(other, kNow), std::nullopt) << "a stranger";
    other = good;
    other.hidden = true;
    EXPECT_EQ(Visibility::visible(other, kNow), std::nullopt);
    other = good;
    other.grant->until = kNow;
    EXPECT_EQ(Visibility::visible(other, kNow), std::nullopt) << "over";
    EXPECT_TRUE(Visibility::visible(other, kNow - 1));
    other.latest = kNow + 5;
    EXPECT_EQ(Visibility::visible(other, kNow - 1), std::nullopt) << "a clock that was set back";
    other = good;
    other.grant->from = kNow - 59;
    EXPECT_EQ(Visibility::visible(other, kNow), std::nullopt) << "from before the grant";
    other = good;
    other.shownSince = kNow - 59;
    EXPECT_EQ(Visibility::visible(other, kNow), std::nullopt) << "from before the last showing";
    other = good;
    other.retention = 59;
    EXPECT_EQ(Visibility::visible(other, kNow), std::nullopt) << "too old";
    other = good;
    other.fixes.clear();
    EXPECT_EQ(Visibility::visible(other, kNow), std::nullopt);
}

TEST_F(VisibilityTest, Town_IsACellOnTheGridOfTime) {
    Sharing sharing = shared(Precision::Town);
    const std::int64_t slot = kNow - kNow % 900;
    sharing.fixes = {fix(slot - 1000, 50.2, -3.1)};
    const auto seen = Visibility::visible(sharing, kNow);
    ASSERT_TRUE(seen);
    const auto place = Cell::of(50.2, -3.1, 4000.0).place(4000.0);
    EXPECT_EQ(*seen, (Seen{place.latitude, place.longitude, place.radius, slot - 1800}));
    EXPECT_GE(place.radius, 2000.0);
}

TEST_F(VisibilityTest, Town_FollowsAfterTwoSlotsInTheNewCell) {
    Sharing sharing = shared(Precision::Town);
    const std::int64_t slot = kNow - kNow % 900;
    // Home for long; away since the slot before the last one began.
    sharing.fixes = {fix(slot - 9000, 50.2, -3.1), fix(slot - 899, 51.2, -3.1)};
    const auto home = Cell::of(50.2, -3.1, 4000.0).place(4000.0);
    const auto away = Cell::of(51.2, -3.1, 4000.0).place(4000.0);
    EXPECT_EQ(Visibility::visible(sharing, slot)->latitude, home.latitude);
    EXPECT_EQ(Visibility::visible(sharing, slot + 899)->latitude, home.latitude);
    EXPECT_EQ(Visibility::visible(sharing, slot + 900)->latitude, away.latitude);
}

TEST_F(VisibilityTest, Town_DoesNotFollowToAndFroOverAnEdge) {
    Sharing sharing = shared(Precision::Town);
    const std::int64_t slot = kNow - kNow % 900;
    for (int i = 40; i > 0; --i) {
        sharing.fixes.push_back(fix(slot - i * 900L + 10, i % 2 == 0 ? 50.2 : 51.2, -3.1));
    }
    std::set<double> latitudes;
    for (std::int64_t now = slot - 30L * 900; now <= slot; now += 450) {
        latitudes.insert(Visibility::visible(sharing, now)->latitude);
    }
    EXPECT_EQ(latitudes.size(), 1U);
}

TEST_F(VisibilityTest, WhatWasHeardBeforeTheGrantOrTheShowing_IsFromBeforeIt_WhateverThePhonesClockSays) {
    Sharing sharing = shared(Precision::Exact);
    sharing.fixes = {fix(kNow + 200, 50.2, -3.1)};
    sharing.fixes[0].heard = kNow - 20;
    ASSERT_TRUE(Visibility::visible(sharing, kNow));
    sharing.shownSince = kNow - 10;
    EXPECT_EQ(Visibility::visible(sharing, kNow), std::nullopt);
    sharing.shownSince = 0;
    sharing.grant->from = kNow - 10;
    EXPECT_EQ(Visibility::visible(sharing, kNow), std::nullopt);
}

TEST_F(VisibilityTest, GrantWithoutEnd_AsksAfter90Days_AndEndsAfter7More) {
    Sharing sharing = shared(Precision::Exact);
    sharing.fixes = {fix(kNow - 60, 50.2, -3.1)};
    sharing.grant->from = kNow - 97 * kDay + 1;
    EXPECT_TRUE(sharing.grant->asks(kNow));
    EXPECT_TRUE(Visibility::visible(sharing, kNow));
    sharing.latest = kNow + 1;
    EXPECT_EQ(Visibility::visible(sharing, kNow), std::nullopt) << "by the latest time of all";
    sharing.grant->confirmed = kNow - 8 * kDay;
    EXPECT_FALSE(sharing.grant->asks(kNow));
    EXPECT_TRUE(Visibility::visible(sharing, kNow));
    EXPECT_FALSE(sharing.grant->asks(kNow + 82 * kDay - 1));
    EXPECT_TRUE(sharing.grant->asks(kNow + 82 * kDay));
    EXPECT_FALSE(sharing.grant->asks(kNow + 89 * kDay)) << "then it is over";
    sharing.grant->until = kNow + 500 * kDay;
    EXPECT_FALSE(sharing.grant->asks(kNow + 82 * kDay)) << "who said until when is not asked";
}

TEST_F(VisibilityTest, Exact_SaysTheOwnersPlace_OnlyIfThatMayBeSaid) {
    Sharing sharing = shared(Precision::Exact);
    sharing.fixes = {fix(kNow - 60, 50.2, -3.1)};
    sharing.places = {{1, "Work", "work", 50.2, -3.1, 150.0, true}, {2, "Clinic", "", 50.2, -3.1, 100.0, false}};
    EXPECT_EQ(Visibility::visible(sharing, kNow), (Seen{50.2, -3.1, 12.0, kNow - 60, "Work", "work", true}));
    sharing.places.push_back({3, "Canteen", "", 50.2, -3.1, 110.0, true});
    EXPECT_EQ(Visibility::visible(sharing, kNow)->place, "Canteen") << "the smaller one";
    sharing.fixes[0].accuracy = 201.0;
    EXPECT_EQ(Visibility::visible(sharing, kNow)->place, "") << "nobody knows whether it is there";
    for (const Precision coarse : {Precision::Kilometre, Precision::Town}) {
        sharing.fixes = {fix(kNow - 3600, 50.2, -3.1)};
        sharing.grant->precision = coarse;
        EXPECT_EQ(Visibility::visible(sharing, kNow)->place, "");
        EXPECT_EQ(Visibility::visible(sharing, kNow)->label, "");
    }
}

TEST_F(VisibilityTest, OnlyNamedPlaces_SayNothingBetween_AndNothingOfPlacesPassed) {
    Sharing sharing = shared(Precision::Places);
    sharing.places = {{1, "Work", "work", 50.2, -3.1, 150.0, true}, {2, "Clinic", "", 50.3, -3.1, 150.0, false}};
    const std::int64_t slot = kNow - kNow % 300;
    sharing.fixes = {fix(slot - 900, 50.2004, -3.1)};
    EXPECT_EQ(Visibility::visible(sharing, slot), (Seen{50.2, -3.1, 150.0, slot - 900, "Work", "work"}))
        << "the place stands for the person";
    sharing.fixes.push_back(fix(slot - 299, 50.25, -3.1));
    EXPECT_TRUE(Visibility::visible(sharing, slot)) << "not yet two slots away";
    EXPECT_TRUE(Visibility::visible(sharing, slot + 299));
    EXPECT_EQ(Visibility::visible(sharing, slot + 300), std::nullopt);
    sharing.fixes.push_back(fix(slot + 1, 50.3, -3.1));
    EXPECT_EQ(Visibility::visible(sharing, slot + 3000), std::nullopt) << "a place that may not be said";
    sharing.places[1].said = true;
    EXPECT_TRUE(Visibility::visible(sharing, slot + 3000));
    sharing.fixes = {fix(slot - 900, 50.25, -3.1), fix(slot - 500, 50.2, -3.1), fix(slot - 250, 50.25, -3.1)};
    for (std::int64_t now = slot - 900; now < slot + 2000; now += 50) {
        EXPECT_EQ(Visibility::visible(sharing, now), std::nullopt) << "only passed through";
    }
}

TEST_F(VisibilityTest, CoarsePlaces_DisappearOnTheGridOfTimeToo_AndBeforeTheyAreDeleted) {
    for (const Precision precision : {Precision::Town, Precision::Kilometre, Precision::Places}) {
        Sharing sharing = shared(precision);
        sharing.retention = kDay;
        sharing.places = {{1, "Work", "work", 50.2, -3.1, 150.0, true}};
        sharing.fixes = {fix(kNow - kDay / 2 + 77, 50.2, -3.1)};
        const std::int64_t length = Visibility::slotLength(precision);
        bool before = true;
        for (std::int64_t now = kNow; now < kNow + kDay; ++now) {
            const bool seen = Visibility::visible(sharing, now).has_value();
            ASSERT_TRUE(seen == before || now % length == 0) << now;
            ASSERT_FALSE(seen && sharing.fixes[0].time < now - sharing.retention) << "the store has deleted it";
            before = seen;
        }
        EXPECT_FALSE(before);
    }
}

}  // namespace ktr::test
