// Who sees what, drawn by lot: whatever `Visibility` must not depend on is changed, and nothing that leaves the service
// changes with it. Ten thousand rounds in ten runs; a million with KTR_LONG_TESTS=1, a tenth of that under sanitizers.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <map>
#include <random>

#include "platform/base/Json.h"
#include "server/answers/LocationAnswers.h"
#include "server/answers/PhoneAnswer.h"
#include "server/rules/Cell.h"
#include "server/rules/FixWalk.h"
#include "server/rules/Visibility.h"

namespace ktr::test {

using server::AskedFriend;
using server::Cell;
using server::CommandPlace;
using server::Fix;
using server::FixEdge;
using server::FixRange;
using server::FixWalk;
using server::Grant;
using server::LastRest;
using server::LocationAnswers;
using server::LocationsRequest;
using server::NamedPlace;
using server::PhoneAnswer;
using server::Precision;
using server::Seen;
using server::Sharing;
using server::Visibility;

namespace {

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr int kLong = 10000;  // each round takes several times as long
#else
constexpr int kLong = 100000;
#endif

}  // namespace

class VisibilityPropertyTest : public ::testing::TestWithParam<int> {
  protected:
    static constexpr std::int64_t kNow = 1763760300;  // a third into a town slot
    static constexpr std::int64_t kDay = 86400;

    static int rounds() { return std::getenv("KTR_LONG_TESTS") == nullptr ? 1000 : kLong; }

    std::int64_t between(std::int64_t least, std::int64_t most) {
        return std::uniform_int_distribution<std::int64_t>(least, most)(random_);
    }
    double real(double least, double most) { return std::uniform_real_distribution<double>(least, most)(random_); }

    Sharing drawn() {
        Sharing sharing;
        sharing.retention = between(0, 3) == 0 ? between(1, 2 * kDay) : 2 * kDay;
        sharing.grant = Grant{static_cast<Precision>(between(0, 3)), kNow - between(0, 2 * kDay), std::nullopt};
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
            const std::int64_t time = kNow - between(-300, 2 * kDay);
            sharing.fixes.push_back(
                {time, between(0, 3) == 0 ? kNow - between(0, 4000) : time, latitude, longitude, 12.0});
            if (between(0, 1) == 0) {
                sharing.places.push_back({i + 1, "Place " + std::to_string(i), between(0, 1) == 0 ? "home" : "",
                                          latitude, longitude, real(100.0, 5000.0), between(0, 2) != 0});
            }
        }
        sort(sharing);
        return sharing;
    }
    static void sort(Sharing& sharing) {
        std::stable_sort(sharing.fixes.begin(), sharing.fixes.end(),
                         [](const Fix& a, const Fix& b) { return a.time < b.time; });
    }
    /// Everything that leaves the service about somebody, as bytes: answers to a reader and to a phone, when to ask
    /// again, and whether a look is noted.
    static std::string bytes(const std::optional<Seen>& seen) {
        LocationsRequest request;
        request.handles = {"ann@x.example"};
        request.mine = CommandPlace{50.0, -3.0, std::nullopt};
        request.wanted = CommandPlace{50.1, -3.0, std::nullopt};
        std::string text = platform::writeJson(LocationAnswers::locations(request, {{"ann@x.example", 1, seen}}));
        if (seen) {
            text += platform::writeJson(PhoneAnswer::messages({{"Ann", *seen, true}})) + " looked";
        }
        return text;
    }
    /// The same bytes now, and nothing that happens at another time within the next two hours.
    ::testing::AssertionResult alike(const Sharing& one, const Sharing& other) {
        const auto seen = Visibility::visible(one, kNow);
        if (bytes(Visibility::visible(other, kNow)) != bytes(seen)) {
            return ::testing::AssertionFailure() << "now";
        }
        for (int i = 0; i < 6; ++i) {
            // Beside the edges of the slots, and anywhere.
            const std::int64_t edge = (kNow / 300 + between(1, 24)) * 300;
            const std::int64_t now = i % 2 == 0 ? edge - between(0, 1) : kNow + between(0, 7200);
            if (Visibility::visible(one, now) != Visibility::visible(other, now)) {
                return ::testing::AssertionFailure() << "after " << now - kNow << " seconds";
            }
        }
        return ::testing::AssertionSuccess();
    }

    /// Answers what a walk asks.
    std::vector<Fix> walked(FixWalk& walk, const std::vector<Fix>& fixes) {
        for (auto questions = walk.questions(); !questions.empty(); questions = walk.questions()) {
            std::vector<std::optional<Fix>> answers;
            for (const auto& [range, edge] : questions) {
                answers.emplace_back();
                for (const Fix& fix : fixes) {
                    if (range.holds(fix) && (!answers.back() || edge == FixEdge::Last)) {
                        answers.back() = fix;
                    }
                }
                answered_ += answers.back() ? 1 : 0;
            }
            walk.take(answers);
        }
        return walk.fixes();
    }

    std::size_t answered_ = 0;
    std::mt19937_64 random_{20261122U + static_cast<unsigned>(GetParam())};
};

TEST_P(VisibilityPropertyTest, WhatMayNotCount_ChangesNothing) {
    int visible = 0;
    for (int round = 0; round < rounds(); ++round) {
        const Sharing sharing = drawn();
        const Grant& grant = *sharing.grant;
        const auto seen = Visibility::visible(sharing, kNow);
        visible += seen ? 1 : 0;
        const bool over = std::max(kNow, sharing.latest) >= grant.end();
        if (sharing.hidden || over || kNow < grant.from) {
            ASSERT_EQ(seen, std::nullopt);
        }
        // Another past before the grant, the last showing, or the retention.
        Sharing other = sharing;
        const std::int64_t shared = std::max(grant.from, sharing.shownSince);
        const auto counts = [&](const Fix& one) {
            return std::min(one.time, one.heard) >= shared && one.time >= kNow - sharing.retention;
        };
        for (Fix& one : other.fixes) {
            if (!counts(one)) {
                one.latitude = real(-80.0, 80.0);
                one.longitude = real(-179.0, 179.0);
                one.accuracy = real(1.0, 1000.0);
            }
        }
        for (int i = 0; i < 3; ++i) {
            const std::int64_t time = shared - 1 - between(0, kDay);
            other.fixes.push_back({time, time + between(0, 3 * kDay), real(-80.0, 80.0), 0.0, 5.0});
            const std::int64_t heard = shared - 1 - between(0, kDay);
            other.fixes.push_back({heard + between(0, 300), heard, real(-80.0, 80.0), 0.0, 5.0});
        }
        // Places that may not be said say nothing; none does in a cell.
        const bool cells = Visibility::cellSide(grant.precision) > 0.0;
        for (NamedPlace& place : other.places) {
            if (cells || !place.said) {
                place.name = "another";
                place.latitude = real(-80.0, 80.0);
                place.radius = real(100.0, 5000.0);
            }
        }
        sort(other);
        ASSERT_TRUE(alike(sharing, other)) << "round " << round;
        // Another owner of whom nothing is seen looks like one whom nobody knows.
        if (!seen) {
            ASSERT_EQ(bytes(seen), bytes(std::nullopt));
        }
    }
    EXPECT_GT(visible, rounds() / 10) << "else nothing was tried";
}

TEST_P(VisibilityPropertyTest, ThePresentSlot_IsNotSeenBelowExactPrecision) {
    for (int round = 0; round < rounds(); ++round) {
        Sharing sharing = drawn();
        if (sharing.grant->precision == Precision::Exact) {
            sharing.grant->precision = Precision::Town;
        }
        const std::int64_t length = Visibility::slotLength(sharing.grant->precision);
        const std::int64_t slot = kNow / length * length;
        Sharing other = sharing;
        for (int i = 0; i < 3; ++i) {
            other.fixes.push_back({slot + between(0, 300), slot + between(0, 300), real(-80.0, 80.0), 0.0, 5.0});
            other.fixes.push_back({slot - between(0, kDay), slot + between(0, 300), real(-80.0, 80.0), 0.0, 5.0});
            // By a clock that is ahead.
            other.fixes.push_back({slot + between(0, 299), slot - between(1, 300), real(-80.0, 80.0), 0.0, 5.0});
        }
        sort(other);
        for (const std::int64_t now : {kNow, slot, slot + length - 1}) {
            ASSERT_EQ(bytes(Visibility::visible(other, now)), bytes(Visibility::visible(sharing, now)));
        }
    }
}

TEST_P(VisibilityPropertyTest, MovesWithinACell_AreNotSeenBelowExactPrecision) {
    int visible = 0;
    for (int round = 0; round < rounds(); ++round) {
        Sharing sharing = drawn();
        if (sharing.grant->precision == Precision::Exact) {
            sharing.grant->precision = Precision::Town;
        }
        const Precision precision = sharing.grant->precision;
        const double side = Visibility::cellSide(precision);
        const std::int64_t length = Visibility::slotLength(precision);
        visible += Visibility::visible(sharing, kNow) ? 1 : 0;
        Sharing other = sharing;
        // Older ones may become too old on either side of a slot's edge: they keep their times.
        const std::int64_t first =
            std::max({sharing.grant->from, sharing.shownSince, kNow + 3L * 3600 - sharing.retention});
        for (Fix& one : other.fixes) {
            Fix moved = one;
            moved.latitude += real(-0.02, 0.02);
            moved.longitude += real(-0.02, 0.02);
            moved.accuracy = real(1.0, 90.0);
            const bool same =
                side > 0.0
                    ? Cell::of(moved.latitude, moved.longitude, side) == Cell::of(one.latitude, one.longitude, side)
                    : NamedPlace::saidAt(sharing.places, moved) == NamedPlace::saidAt(sharing.places, one);
            if (same) {
                one = moved;
            }
            // Within its slots, when it was and when it was heard.
            const auto slotOf = [length](std::int64_t time) { return time / length; };
            const bool alone = std::count_if(other.fixes.begin(), other.fixes.end(),
                                             [&](const Fix& fix) { return slotOf(fix.time) == slotOf(one.time); }) == 1;
            const std::int64_t time = slotOf(one.time) * length + between(0, length - 1);
            const std::int64_t heard = slotOf(one.heard) * length + between(0, length - 1);
            if (alone && std::min({time, one.time, heard, one.heard}) >= first) {
                one.time = time;
                one.heard = heard;
            }
        }
        ASSERT_TRUE(alike(sharing, other)) << "round " << round << ", " << wordOf(precision);
    }
    EXPECT_GT(visible, rounds() / 10);
}

TEST_P(VisibilityPropertyTest, WhatIsNeededOfAHistory_SaysTheSameAsAllOfIt) {
    std::size_t all = 0;
    std::size_t read = 0;
    for (int round = 0; round < rounds(); ++round) {
        Sharing sharing = drawn();
        // A dense stretch beside what is strewn over days: to and fro over the edges of cells, or at rest.
        const std::int64_t begin = kNow - between(0, kDay);
        const std::int64_t pause = between(30, 2000);
        const double stride = between(0, 2) == 0 ? 0.0 : real(0.0, 0.03);
        for (std::int64_t i = between(0, 60); i > 0; --i) {
            const std::int64_t time = begin + i * pause;
            sharing.fixes.push_back({time, between(0, 9) == 0 ? kNow - between(0, 1000) : time,
                                     50.0 + stride * static_cast<double>(between(0, 2)), -3.0, 12.0});
        }
        sharing.places.push_back({99, "Fifty", "", 50.0, -3.0, 1000.0, true});
        sort(sharing);
        // A store keeps each time once.
        sharing.fixes.erase(std::unique(sharing.fixes.begin(), sharing.fixes.end(),
                                        [](const Fix& a, const Fix& b) { return a.time == b.time; }),
                            sharing.fixes.end());
        const std::int64_t now = kNow + between(-7200, 7200);
        Sharing thin = sharing;
        FixWalk walk(sharing, now);
        thin.fixes = walked(walk, sharing.fixes);
        all += sharing.fixes.size();
        read += thin.fixes.size();
        ASSERT_EQ(Visibility::visible(thin, now), Visibility::visible(sharing, now))
            << "round " << round << ", " << wordOf(sharing.grant->precision);
    }
    EXPECT_LT(read, all / 5);
}

TEST_P(VisibilityPropertyTest, WhatIsKnownOfWhereSomebodyRested_ChangesNothing) {
    for (int round = 0; round < rounds() / 100; ++round) {
        // A person on the way, at rest, unheard, and heard late, whom several look at again and again.
        std::vector<Sharing> viewers(4);
        for (Sharing& sharing : viewers) {
            sharing.retention = between(0, 2) == 0 ? 2L * 3600 : 2 * kDay;
            sharing.shownSince = viewers.front().shownSince;
            sharing.grant = Grant{between(0, 1) == 0 ? Precision::Town : Precision::Kilometre,
                                  kNow - between(-7200, 6L * 3600), std::nullopt};
        }
        std::vector<Fix> fixes;
        std::map<Precision, LastRest> known;
        std::int64_t heardLate = 0;
        std::int64_t now = kNow;
        double longitude = -3.0;
        bool moves = true;
        for (int step = 0; step < 400; ++step) {
            now += between(1, between(0, 20) == 0 ? 4000 : 200);
            moves = between(0, 15) == 0 ? !moves : moves;
            longitude += moves ? real(-0.02, 0.08) : 0.0;
            const std::int64_t ahead = between(0, 9) == 0 ? between(0, 300) : 0;
            const std::int64_t behind = between(0, 15) == 0 ? between(0, 5000) : between(0, 3);
            const Fix fix{now + ahead - behind, now, 50.0, longitude, 12.0};
            heardLate = FixWalk::isLate(fix, now) ? now : heardLate;
            const auto place = std::lower_bound(fixes.begin(), fixes.end(), fix,
                                                [](const Fix& a, const Fix& b) { return a.time < b.time; });
            if (place == fixes.end() || place->time != fix.time) {
                fixes.insert(place, fix);
            }
            Sharing& sharing = viewers[static_cast<std::size_t>(between(0, 3))];
            sharing.fixes = fixes;
            Sharing thin = sharing;
            FixWalk walk(sharing, now, known[sharing.grant->precision], heardLate);
            thin.fixes = walked(walk, fixes);
            known[sharing.grant->precision] = walk.found().value_or(known[sharing.grant->precision]);
            ASSERT_EQ(Visibility::visible(thin, now), Visibility::visible(sharing, now))
                << "round " << round << ", step " << step;
        }
    }
}

TEST_P(VisibilityPropertyTest, WhoeverNeverRests_IsReadOnceAsFarBack) {
    Sharing sharing;
    sharing.retention = 2 * kDay;
    const bool isTown = GetParam() % 2 == 0;
    sharing.grant = Grant{isTown ? Precision::Town : Precision::Kilometre, kNow - 3 * kDay, std::nullopt};
    double longitude = -3.0;
    for (std::int64_t time = kNow - 2 * kDay; time < kNow + kDay / 4; time += 60) {
        longitude += isTown ? 0.01 : 0.02;
        sharing.fixes.push_back({time, time + 1, 50.0, longitude, 12.0});
    }
    LastRest known;
    for (std::int64_t now = kNow; now < kNow + kDay / 4; now += between(1, 600)) {
        answered_ = 0;
        FixWalk walk(sharing, now, known, 0);
        Sharing thin = sharing;
        thin.fixes = walked(walk, sharing.fixes);
        ASSERT_EQ(Visibility::visible(thin, now), Visibility::visible(sharing, now));
        if (now > kNow) {
            EXPECT_LE(answered_, 6U);
        } else {
            EXPECT_GT(answered_, 100U) << "else this tries nothing";
        }
        known = walk.found().value_or(known);
    }
}

TEST_P(VisibilityPropertyTest, ProbingPositions_DoNotNarrowATown) {
    Sharing one;
    one.retention = 2 * kDay;
    one.grant = Grant{Precision::Town, kNow - kDay, std::nullopt};
    Sharing other = one;
    const auto place = Cell::of(50.2, -3.1, 4000.0).place(4000.0);
    one.fixes = {{kNow - 7200, kNow - 7200, place.latitude + 0.01, place.longitude + 0.01, 12.0}};
    other.fixes = {{kNow - 7200, kNow - 7200, place.latitude - 0.01, place.longitude - 0.015, 40.0}};
    const auto seen = Visibility::visible(one, kNow);
    const auto same = Visibility::visible(other, kNow);
    ASSERT_TRUE(seen);
    EXPECT_GE(*seen->accuracy, 2000.0);
    for (int probe = 0; probe < 10000; ++probe) {
        LocationsRequest request;
        request.mine = CommandPlace{50.2 + real(-0.1, 0.1), -3.1 + real(-0.1, 0.1), std::nullopt};
        request.wanted = CommandPlace{50.2 + real(-0.05, 0.05), -3.1 + real(-0.05, 0.05), std::nullopt};
        ASSERT_EQ(LocationAnswers::locations(request, {{"a", 1, seen}}),
                  LocationAnswers::locations(request, {{"a", 1, same}}));
    }
}

INSTANTIATE_TEST_SUITE_P(Histories, VisibilityPropertyTest, ::testing::Range(0, 10));

}  // namespace ktr::test
