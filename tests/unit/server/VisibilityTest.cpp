#include "server/rules/Visibility.h"

#include <gtest/gtest.h>

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>
#include <random>
#include <set>

#include "platform/base/Json.h"
#include "server/answers/LocationAnswers.h"
#include "server/answers/PhoneAnswer.h"
#include "server/rules/Cell.h"

namespace ktr::test {

using server::AskedFriend;
using server::Cell;
using server::CommandPlace;
using server::Fix;
using server::Grant;
using server::LocationAnswers;
using server::LocationsRequest;
using server::PhoneAnswer;
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
    EXPECT_EQ(Visibility::visible(sharing, kNow), (Seen{50.2, -3.1, 12.0, kNow - 60}));
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
        sharing.fixes.push_back(fix(slot - i * 900 + 10, i % 2 == 0 ? 50.2 : 51.2, -3.1));
    }
    std::set<double> latitudes;
    for (std::int64_t now = slot - 30 * 900; now <= slot; now += 450) {
        latitudes.insert(Visibility::visible(sharing, now)->latitude);
    }
    EXPECT_EQ(latitudes.size(), 1U);
}

/// What decides who sees what, drawn by lot.
class VisibilityPropertyTest : public VisibilityTest {
  protected:
    static constexpr int kRounds = 10000;

    std::int64_t between(std::int64_t least, std::int64_t most) {
        return std::uniform_int_distribution<std::int64_t>(least, most)(random_);
    }
    double real(double least, double most) { return std::uniform_real_distribution<double>(least, most)(random_); }

    Sharing drawn() {
        Sharing sharing = shared(static_cast<Precision>(between(0, 2)));
        sharing.grant->from = kNow - between(0, 2 * kDay);
        if (between(0, 3) == 0) {
            sharing.grant->until = kNow + between(-3600, 3600);
        }
        sharing.hidden = between(0, 9) == 0;
        sharing.shownSince = between(0, 4) == 0 ? kNow - between(0, kDay) : 0;
        sharing.latest = kNow + between(-3600, 1800);
        double latitude = real(-80.0, 80.0);
        double longitude = real(-179.0, 179.0);
        const auto count = between(0, 12);
        for (std::int64_t i = 0; i < count; ++i) {
            latitude += real(-0.05, 0.05);
            longitude += real(-0.05, 0.05);
            Fix one = fix(kNow - between(-300, 2 * kDay), latitude, longitude);
            one.heard = between(0, 3) == 0 ? kNow - between(0, 4000) : one.time;
            sharing.fixes.push_back(one);
        }
        sort(sharing);
        return sharing;
    }
    static void sort(Sharing& sharing) {
        std::sort(sharing.fixes.begin(), sharing.fixes.end(),
                  [](const Fix& a, const Fix& b) { return a.time < b.time; });
    }
    /// Everything that leaves the service about somebody, as bytes.
    static std::string bytes(const std::optional<Seen>& seen) {
        LocationsRequest request;
        request.handles = {"ann@x.example"};
        request.mine = CommandPlace{50.0, -3.0, std::nullopt};
        request.wanted = CommandPlace{50.1, -3.0, std::nullopt};
        std::string text = platform::writeJson(LocationAnswers::locations(request, {{"ann@x.example", 1, seen}}));
        if (seen) {
            text += platform::writeJson(PhoneAnswer::messages({{"Ann", *seen}}, true));
        }
        return text;
    }

    std::mt19937_64 random_{20261122};
};

TEST_F(VisibilityPropertyTest, WhatMayNotCount_ChangesNothing) {
    int visible = 0;
    for (int round = 0; round < kRounds; ++round) {
        const Sharing sharing = drawn();
        const auto seen = Visibility::visible(sharing, kNow);
        visible += seen ? 1 : 0;
        const bool over = sharing.grant->until && std::max(kNow, sharing.latest) >= *sharing.grant->until;
        if (sharing.hidden || over || kNow < sharing.grant->from) {
            EXPECT_EQ(seen, std::nullopt);
        }
        // Another past before the grant or the last showing, another present below exact precision.
        Sharing other = sharing;
        const std::int64_t first = std::max({sharing.grant->from, sharing.shownSince, kNow - sharing.retention});
        const std::int64_t length = Visibility::slotLength(sharing.grant->precision);
        const std::int64_t slot = kNow / length * length;
        for (Fix& one : other.fixes) {
            const bool early = one.time < first;
            const bool late = length > 1 && (one.heard >= slot || one.time >= slot);
            if (early || late) {
                one.latitude = real(-80.0, 80.0);
                one.longitude = real(-179.0, 179.0);
                one.accuracy = real(1.0, 1000.0);
            }
        }
        for (int i = 0; i < 3; ++i) {
            other.fixes.push_back(fix(first - 1 - between(0, kDay), real(-80.0, 80.0), 0.0));
            if (length > 1) {
                other.fixes.push_back(fix(slot + between(0, 300), real(-80.0, 80.0), 0.0));
            }
        }
        sort(other);
        EXPECT_EQ(bytes(Visibility::visible(other, kNow)), bytes(seen));
        if (sharing.hidden || over) {
            EXPECT_EQ(bytes(seen), bytes(std::nullopt));
        }
    }
    EXPECT_GT(visible, kRounds / 10) << "else nothing was tried";
}

TEST_F(VisibilityPropertyTest, MovesWithinACell_AreNotSeenBelowExactPrecision) {
    int visible = 0;
    for (int round = 0; round < kRounds; ++round) {
        Sharing sharing = drawn();
        if (sharing.grant->precision == Precision::Exact) {
            sharing.grant->precision = Precision::Town;
        }
        const double side = Visibility::cellSide(sharing.grant->precision);
        const std::int64_t length = Visibility::slotLength(sharing.grant->precision);
        const auto seen = Visibility::visible(sharing, kNow);
        visible += seen ? 1 : 0;
        Sharing other = sharing;
        const std::int64_t first = std::max({sharing.grant->from, sharing.shownSince, kNow - sharing.retention});
        for (Fix& one : other.fixes) {
            const Cell cell = Cell::of(one.latitude, one.longitude, side);
            const double latitude = one.latitude + real(-0.02, 0.02);
            const double longitude = one.longitude + real(-0.02, 0.02);
            if (Cell::of(latitude, longitude, side) == cell) {
                one.latitude = latitude;
                one.longitude = longitude;
            }
            one.accuracy = real(1.0, 500.0);
            // Within its slot, on the same side of what is too early.
            const std::int64_t time = one.time / length * length + between(0, length - 1);
            const bool alone = std::count_if(other.fixes.begin(), other.fixes.end(), [&](const Fix& fix) {
                                   return fix.time / length == one.time / length;
                               }) == 1;
            if (alone && (time < first) == (one.time < first)) {
                one.time = time;
            }
        }
        EXPECT_EQ(bytes(Visibility::visible(other, kNow)), bytes(seen));
    }
    EXPECT_GT(visible, kRounds / 10);
}

TEST_F(VisibilityPropertyTest, ProbingPositions_DoNotNarrowATown) {
    Sharing one = shared(Precision::Town);
    Sharing other = one;
    const auto place = Cell::of(50.2, -3.1, 4000.0).place(4000.0);
    one.fixes = {fix(kNow - 7200, place.latitude + 0.01, place.longitude + 0.01)};
    other.fixes = {fix(kNow - 7200, place.latitude - 0.01, place.longitude - 0.015)};
    const auto seen = Visibility::visible(one, kNow);
    const auto same = Visibility::visible(other, kNow);
    for (int probe = 0; probe < 10000; ++probe) {
        LocationsRequest request;
        request.mine = CommandPlace{50.2 + real(-0.1, 0.1), -3.1 + real(-0.1, 0.1), std::nullopt};
        request.wanted = CommandPlace{50.2 + real(-0.05, 0.05), -3.1 + real(-0.05, 0.05), std::nullopt};
        ASSERT_EQ(LocationAnswers::locations(request, {{"a", 1, seen}}),
                  LocationAnswers::locations(request, {{"a", 1, same}}));
    }
}

}  // namespace ktr::test
