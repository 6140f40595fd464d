#include "server/admin/LocalTime.h"

#include <gtest/gtest.h>

#include "server/service/FailureDelays.h"
#include "tests/support/EnvironmentVariable.h"

namespace ktr::test {

using server::endingOf;
using server::FailureDelays;

TEST(LocalTimeTest, Endings_AreTheNextOnesOfTheClockOnTheWall) {
    const EnvironmentVariable zone("TZ", "UTC-1");  // an hour east of Greenwich
    constexpr std::int64_t kNow = 1763760000;       // 22:20 there
    EXPECT_EQ(endingOf("midnight", kNow), kNow + 100 * 60);
    EXPECT_EQ(endingOf("22:21", kNow), kNow + 60);
    EXPECT_EQ(endingOf("22:20", kNow), kNow + 86400);
    EXPECT_EQ(endingOf("7:05", kNow), kNow + (8 * 60 + 45) * 60);
    EXPECT_EQ(endingOf("2025-11-21T21:30:00Z", kNow), kNow + 600);
    for (const char* words :
         {"", "soon", "24:00", "12:60", "1:2:3", "-1:00", "2025-11-21T21:20:00Z", "2020-01-01T00:00:00Z"}) {
        EXPECT_EQ(endingOf(words, kNow), std::nullopt) << words;
    }
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
