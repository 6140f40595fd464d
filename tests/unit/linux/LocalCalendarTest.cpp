#include "linux/locale/LocalCalendar.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "tests/support/EnvironmentVariable.h"

namespace ktr::linux_ {

namespace {

using platform::Date;
using TimeOfDay = platform::Calendar::TimeOfDay;

/// Central Europe by rule, so that no zone files are needed: summer time from the last Sunday of March, 2:00, to the
/// last Sunday of October, 3:00.
constexpr const char* kBerlin = "CET-1CEST,M3.5.0/2,M10.5.0/3";

/// A moment by its UTC time on a day of 2026, counted from 2026-01-01.
Date moment(int dayOfYear, int hour, int minute = 0, double second = 0.0) {
    constexpr double kStartOf2026 = 788918400.0;
    return {kStartOf2026 + dayOfYear * 86400.0 + hour * 3600.0 + minute * 60.0 + second};
}

// 2026-03-29 and 2026-10-25.
constexpr int kSpring = 87;
constexpr int kAutumn = 297;

class LocalCalendarTest : public ::testing::Test {
  protected:
    test::EnvironmentVariable zone{"TZ", kBerlin};
    LocalCalendar calendar;
};

}  // namespace

TEST_F(LocalCalendarTest, TimeOfDay_FollowsTheZone) {
    EXPECT_EQ(calendar.timeOfDay(moment(0, 12)), (TimeOfDay{13, 0, 0}));
    EXPECT_EQ(calendar.timeOfDay(moment(180, 12)), (TimeOfDay{14, 0, 0}));
}

TEST_F(LocalCalendarTest, TimeOfDay_FollowsAChangeOfTheZone) {
    const test::EnvironmentVariable elsewhere("TZ", "IST-5:30");
    EXPECT_EQ(calendar.timeOfDay(moment(0, 12)), (TimeOfDay{17, 30, 0}));
}

TEST_F(LocalCalendarTest, MidnightOfTheSpringChange_IsOneHourNearerThanTheClockSays) {
    // 04:30:15.5 local, two and a half hours after midnight.
    const Date now = moment(kSpring, 2, 30, 15.5);
    EXPECT_EQ(calendar.timeOfDay(now), (TimeOfDay{4, 30, 15}));
    EXPECT_EQ(calendar.adding({-4, -30, -15}, now), moment(kSpring - 1, 23, 0, 0.5));
}

TEST_F(LocalCalendarTest, MidnightOfTheAutumnChange_IsOneHourFarther) {
    const Date now = moment(kAutumn, 11);
    EXPECT_EQ(calendar.timeOfDay(now), (TimeOfDay{12, 0, 0}));
    EXPECT_EQ(calendar.adding({-12, 0, 0}, now), moment(kAutumn - 1, 22));
}

TEST_F(LocalCalendarTest, ATimeThatIsSkipped_MovesForward) {
    // 01:30 local and one hour more would be 02:30, which does not come: 03:30.
    const Date result = calendar.adding({1, 0, 0}, moment(kSpring, 0, 30));
    EXPECT_EQ(calendar.timeOfDay(result), (TimeOfDay{3, 30, 0}));
    EXPECT_EQ(result, moment(kSpring, 1, 30));
}

TEST_F(LocalCalendarTest, ATimeThatComesTwice_KeepsTheDatesOwnOffset) {
    // 02:45 for the second time, less ten minutes.
    EXPECT_EQ(calendar.adding({0, -10, 0}, moment(kAutumn, 1, 45)), moment(kAutumn, 1, 35));
    // 02:45 for the first time.
    EXPECT_EQ(calendar.adding({0, -10, 0}, moment(kAutumn, 0, 45)), moment(kAutumn, 0, 35));
}

TEST_F(LocalCalendarTest, AddingNothingToATimeThatComesTwice_GivesTheDate) {
    EXPECT_EQ(calendar.adding({}, moment(kAutumn, 1, 30)), moment(kAutumn, 1, 30));
}

TEST_F(LocalCalendarTest, AcrossTheChange_TheClockFaceCounts) {
    // Noon of the day before the change and 24 hours on the clock: noon again, 23 hours later.
    EXPECT_EQ(calendar.adding({24, 0, 0}, moment(kSpring - 1, 11)), moment(kSpring, 10));
}

TEST_F(LocalCalendarTest, ASkippedDay_MovesForward) {
    // Across the date line: a zone that jumps by a day would need zone files; half a day by rule shows the same.
    const test::EnvironmentVariable jumping("TZ", "XXX6YYY-6,M3.5.0/2,M10.5.0/3");
    const Date before = moment(kSpring, 7);  // 01:00 local, offset -6
    EXPECT_EQ(calendar.timeOfDay(before), (TimeOfDay{1, 0, 0}));
    const Date after = calendar.adding({3, 0, 0}, before);
    EXPECT_EQ(calendar.timeOfDay(after), (TimeOfDay{16, 0, 0}));
}

TEST_F(LocalCalendarTest, DatesOutOfReach_AreTakenAsTheyAre) {
    for (const double seconds : {std::numeric_limits<double>::infinity(), -1e300}) {
        EXPECT_EQ(calendar.timeOfDay({seconds}), TimeOfDay{});
        EXPECT_EQ(calendar.adding({-1, 0, 0}, {seconds}), Date{seconds});
    }
    EXPECT_TRUE(std::isnan(calendar.adding({1, 0, 0}, {std::nan("")}).secondsSinceReferenceDate));
}

TEST_F(LocalCalendarTest, LargestAmounts_DoNotOverflow) {
    constexpr int kMost = std::numeric_limits<int>::max();
    EXPECT_TRUE(std::isfinite(calendar.adding({kMost, kMost, kMost}, {0.0}).secondsSinceReferenceDate));
}

}  // namespace ktr::linux_
