#include "server/rules/WallClock.h"

#include <gtest/gtest.h>

#include "server/service/FailureDelays.h"
#include "tests/support/EnvironmentVariable.h"

namespace ktr::test {

using server::FailureDelays;
using server::WallClock;

TEST(WallClockTest, Endings_AreTheNextOnesOfTheClockOnTheWall) {
    const WallClock clock("Etc/GMT-1");        // an hour east of Greenwich
    constexpr std::int64_t kNow = 1763760000;  // 22:20 there
    EXPECT_EQ(clock.endingOf("midnight", kNow), kNow + 100 * 60);
    EXPECT_EQ(clock.endingOf("22:21", kNow), kNow + 60);
    EXPECT_EQ(clock.endingOf("22:20", kNow), kNow + 86400);
    EXPECT_EQ(clock.endingOf("7:05", kNow), kNow + (8 * 60 + 45) * 60);
    EXPECT_EQ(clock.endingOf("2025-11-21T21:30:00Z", kNow), kNow + 600);
    for (const char* words :
         {"", "soon", "24:00", "12:60", "1:2:3", "-1:00", "1:-1", "2025-11-21T21:20:00Z", "2020-01-01T00:00:00Z"}) {
        EXPECT_EQ(clock.endingOf(words, kNow), std::nullopt) << words;
    }
}

TEST(WallClockTest, Midnight_IsThatOfTheZone_AlsoInTheNightWhenClocksChange) {
    constexpr std::int64_t kEvening = 1774724400;  // 2026-03-28 19:00 in Greenwich
    EXPECT_EQ(WallClock("Asia/Tokyo").endingOf("midnight", kEvening), 1774796400);
    EXPECT_EQ(WallClock("Europe/Berlin").endingOf("midnight", kEvening), 1774738800);
    // At two in the morning of the 29th it is three o'clock: that day has 23 hours.
    EXPECT_EQ(WallClock("Europe/Berlin").next(24, 0, 1774738800), 1774738800 + 23 * 3600);
    EXPECT_EQ(WallClock("Europe/Berlin").next(20, 0, kEvening), kEvening + 23 * 3600) << "20:00 was an hour ago then";
}

TEST(WallClockTest, MidnightItself_MeansTheNextOne) {
    constexpr std::int64_t kMidnight = 1774738800;
    EXPECT_EQ(WallClock("Europe/Berlin").endingOf("midnight", kMidnight - 1), kMidnight);
    EXPECT_EQ(WallClock("Europe/Berlin").endingOf("midnight", kMidnight), kMidnight + 23 * 3600);
}

TEST(WallClockTest, UnknownZones_AreTheMachines) {
    const EnvironmentVariable zone("TZ", "Asia/Tokyo");
    EXPECT_EQ(WallClock::machineZone(), "Asia/Tokyo");
    EXPECT_EQ(WallClock("").zone(), "Asia/Tokyo");
    EXPECT_EQ(WallClock("Mars/Olympus").zone(), "Asia/Tokyo");
    EXPECT_FALSE(WallClock::isZone("Mars/Olympus"));
    EXPECT_FALSE(WallClock::isZone(""));
    EXPECT_TRUE(WallClock::isZone("Europe/Berlin"));
}

TEST(WallClockTest, Face_IsThatOfTheZone) {
    EXPECT_EQ(WallClock("Asia/Tokyo").face(1774796340), "2026-03-29 23:59");
    EXPECT_EQ(WallClock("Europe/Berlin").face(1774796340), "2026-03-29 16:59");
}

TEST(FailureDelaysTest, EachFailureOfAnAddressTakesLonger_UpToABound_AndIsForgotten) {
    FailureDelays delays;
    const auto now = FailureDelays::Clock::now();
    EXPECT_EQ(delays.afterFailure("1.2.3.4", now), 0.25);
    EXPECT_EQ(delays.afterFailure("1.2.3.4", now), 0.5);
    EXPECT_EQ(delays.afterFailure("5.6.7.8", now), 0.25);
    for (int i = 0; i < 50; ++i) {
        EXPECT_LE(delays.afterFailure("1.2.3.4", now), FailureDelays::kLongest);
    }
    EXPECT_EQ(delays.afterFailure("1.2.3.4", now + std::chrono::minutes(11)), 0.25);
}

}  // namespace ktr::test
