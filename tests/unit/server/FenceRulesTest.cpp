#include "server/fences/FenceRules.h"

#include <gtest/gtest.h>

#include <string>

#include "server/simulation/FenceSimulation.h"

namespace ktr::test {

using server::FenceCircle;
using server::FenceCrossing;
using server::FenceRules;
using server::FenceSide;
using server::FenceSimulation;
using server::FenceState;
using server::Fix;

namespace {

constexpr double kDegree = 111230.0;  // metres along a meridian at this latitude, to a thousandth
const FenceCircle kCircle{50.0, -3.0, 100.0};

Fix north(std::int64_t time, double metres, std::optional<double> accuracy) {
    return {time, time, 50.0 + metres / kDegree, -3.0, accuracy};
}

/// A fence, and what it has said so far: "+" for an arrival, "-" for a leaving, with their times.
class Watch {
  public:
    explicit Watch(FenceSide side = FenceSide::Unknown) { state.side = side; }
    std::string take(const Fix& fix) {
        std::string said;
        for (const FenceCrossing& crossing : FenceRules::take(kCircle, state, fix)) {
            said += (crossing.arrives ? "+" : "-") + std::to_string(crossing.time);
        }
        return said;
    }
    std::string take(std::int64_t time, double metres, std::optional<double> accuracy = 10.0) {
        return take(north(time, metres, accuracy));
    }
    FenceState state;
};

}  // namespace

TEST(FenceRulesTest, FirstSide_IsNoCrossing) {
    Watch inside;
    EXPECT_EQ(inside.take(1000, 0.0), "");
    EXPECT_EQ(inside.state.side, FenceSide::Inside);
    Watch outside;
    EXPECT_EQ(outside.take(1000, 500.0), "");
    EXPECT_EQ(outside.state.side, FenceSide::Unknown) << "one fix outside is none";
    EXPECT_EQ(outside.take(1030, 500.0), "");
    EXPECT_EQ(outside.state.side, FenceSide::Outside);
}

TEST(FenceRulesTest, Arrival_TakesOneTightFixOrTwo) {
    Watch tight(FenceSide::Outside);
    EXPECT_EQ(tight.take(1000, 90.0, 50.0), "+1000");
    Watch loose(FenceSide::Outside);
    EXPECT_EQ(loose.take(1000, 90.0, 50.1), "");
    EXPECT_EQ(loose.take(1060, 99.0, 200.0), "+1000") << "the time is that of the first";
    Watch vague(FenceSide::Outside);
    EXPECT_EQ(vague.take(1000, 0.0, 200.1), "");
    EXPECT_EQ(vague.take(1060, 0.0, 200.1), "");
    Watch beside(FenceSide::Outside);
    EXPECT_EQ(beside.take(1000, 101.0, 5.0), "");
}

TEST(FenceRulesTest, Leaving_TakesTwoFixesHalfAMinuteApart) {
    Watch watch(FenceSide::Inside);
    EXPECT_EQ(watch.take(1000, 300.0), "");
    EXPECT_EQ(watch.take(1029, 320.0), "");
    EXPECT_EQ(watch.take(1030, 330.0), "-1000");
    EXPECT_EQ(watch.take(1090, 400.0), "") << "once";
}

TEST(FenceRulesTest, Edge_IsWideOnTheWayOut) {
    Watch watch(FenceSide::Inside);
    EXPECT_EQ(watch.take(1000, 135.0), "");
    EXPECT_EQ(watch.take(1100, 135.0), "") << "135 m less 16 m are within 120 m";
    EXPECT_EQ(watch.take(1200, 137.0), "");
    EXPECT_EQ(watch.take(1300, 137.0), "-1200");
    EXPECT_EQ(watch.take(1400, 110.0), "") << "and narrow on the way in";
    EXPECT_EQ(watch.take(1500, 99.0), "+1500");
}

TEST(FenceRulesTest, FixThatSpeaksForTheOldSide_BeginsItAnew) {
    Watch watch(FenceSide::Inside);
    EXPECT_EQ(watch.take(1000, 500.0), "");
    EXPECT_EQ(watch.take(1900, 0.0), "");
    EXPECT_EQ(watch.take(2800, 500.0), "");
    EXPECT_EQ(watch.take(3700, 0.0, 100.0), "");
    EXPECT_EQ(watch.take(4600, 500.0), "");
    EXPECT_EQ(watch.take(5500, 110.0, 40.0), "") << "says nothing";
    EXPECT_EQ(watch.take(6400, 500.0), "-4600");
}

TEST(FenceRulesTest, Glitch_ConfirmsNothingHoweverTight) {
    Watch away(FenceSide::Outside);
    EXPECT_EQ(away.take(1000, 9000.0), "");
    EXPECT_EQ(away.take(1010, 10.0, 2.0), "") << "900 m/s";
    EXPECT_EQ(away.take(1020, 9000.0), "") << "and back: it was never there";
    EXPECT_EQ(away.state.side, FenceSide::Outside);
    Watch home(FenceSide::Inside);
    EXPECT_EQ(home.take(1000, 0.0), "");
    EXPECT_EQ(home.take(1010, 9000.0), "");
    EXPECT_EQ(home.take(1050, 0.0), "");
    EXPECT_EQ(home.take(1060, 9000.0), "");
    EXPECT_EQ(home.take(1100, 0.0), "");
}

TEST(FenceRulesTest, LeapThatTheNextFixConfirms_Counts) {
    Watch watch(FenceSide::Outside);
    EXPECT_EQ(watch.take(1000, 9000.0), "");
    EXPECT_EQ(watch.take(1010, 10.0, 10.0), "") << "a glitch, or the one before was";
    EXPECT_EQ(watch.take(1070, 12.0, 10.0), "+1010");
}

TEST(FenceRulesTest, VagueFixes_AreNotTakenForSpeed) {
    Watch watch(FenceSide::Outside);
    EXPECT_EQ(watch.take(1000, 3000.0, 3000.0), "");
    EXPECT_EQ(watch.take(1010, 10.0, 10.0), "+1010");
}

TEST(FenceRulesTest, UnknownAccuracy_IsTakenForAHundredMetres) {
    Watch watch(FenceSide::Outside);
    EXPECT_EQ(watch.take(1000, 10.0, std::nullopt), "");
    EXPECT_EQ(watch.take(1060, 10.0, std::nullopt), "+1000");
    EXPECT_EQ(watch.take(2000, 270.0, std::nullopt), "");
    EXPECT_EQ(watch.take(2060, 270.0, std::nullopt), "") << "within 120 m and 160 m more";
    EXPECT_EQ(watch.take(3000, 290.0, std::nullopt), "");
    EXPECT_EQ(watch.take(3060, 290.0, std::nullopt), "-3000");
}

TEST(FenceRulesTest, OldAndDoubledFixes_CountForNothing) {
    Watch watch(FenceSide::Inside);
    EXPECT_EQ(watch.take(1000, 500.0), "");
    EXPECT_EQ(watch.take(1000, 500.0), "");
    EXPECT_EQ(watch.take(900, 500.0), "") << "posted late";
    EXPECT_EQ(watch.take(1031, 500.0), "-1000");
}

TEST(FenceRulesTest, Gap_TakesTwoFixesAsWell) {
    Watch watch(FenceSide::Inside);
    EXPECT_EQ(watch.take(1000, 0.0), "");
    EXPECT_EQ(watch.take(90000, 50000.0), "");
    EXPECT_EQ(watch.take(90900, 50000.0), "-90000");
}

TEST(FenceRulesTest, ClockThatWasSetBack_BeginsAnewOnTheSameSide) {
    Watch watch(FenceSide::Inside);
    EXPECT_EQ(watch.take(1000000, 500.0), "");
    EXPECT_EQ(watch.take(5000, 500.0), "") << "not the second of two";
    EXPECT_EQ(watch.state.side, FenceSide::Inside);
    EXPECT_EQ(watch.take(5030, 500.0), "-5000");
}

TEST(FenceRulesTest, PhoneWhoseClockRanAhead_WaitsUntilTheTimeHasCome) {
    Watch watch(FenceSide::Inside);
    Fix ahead = north(1300, 0.0, 10.0);
    ahead.heard = 1000;
    EXPECT_EQ(watch.take(ahead), "");
    EXPECT_EQ(watch.take(1010, 500.0), "");
    EXPECT_EQ(watch.take(1200, 500.0), "");
    EXPECT_EQ(watch.take(1310, 500.0), "");
    EXPECT_EQ(watch.take(1340, 500.0), "-1310");
}

TEST(FenceSimulationTest, RestingPhones_AreHardlyEverSaidToMove) {
    for (const double metres : {0.0, 80.0}) {
        FenceSimulation::Rest rest;
        rest.metres = metres;
        const auto tally = FenceSimulation(1).rest(rest, 10000.0);
        EXPECT_GT(tally.naive, 9000) << metres;
        EXPECT_LE(tally.rule, 20) << metres;
    }
}

TEST(FenceSimulationTest, JumpsThatLast_AreHardlyEverSaidToBeMoves) {
    FenceSimulation::Rest rest{80.0, 10, 60.0, 3};
    const auto tally = FenceSimulation(1).rest(rest, 100.0);
    EXPECT_GT(tally.naive, 9000);
    EXPECT_LE(tally.rule, 2);
}

TEST(FenceSimulationTest, PeopleWhoCross_AreSeenWithTheSecondFixBeyondTheEdge) {
    constexpr int kCount = 1000;
    for (const bool byCar : {false, true}) {
        const auto crossings = FenceSimulation(2).cross(kCount, byCar);
        EXPECT_EQ(crossings.made, kCount);
        EXPECT_EQ(crossings.seen, kCount) << byCar;
        EXPECT_EQ(crossings.late, 0) << byCar;
        EXPECT_EQ(crossings.unmeant, 0) << byCar;
    }
}

TEST(FenceSimulationTest, SameSeed_GivesTheSameFixes) {
    EXPECT_EQ(FenceSimulation(7).rest({}, 100.0), FenceSimulation(7).rest({}, 100.0));
}

}  // namespace ktr::test
