#include "tests/contract/CalendarContract.h"

#include "tests/support/Doubles.h"

namespace ktr::test {

using platform::Date;
using TimeOfDay = platform::Calendar::TimeOfDay;

namespace {
// 2026-01-15 12:34:56 UTC.
constexpr double kMoment = 790173296.0;
}  // namespace

TEST_P(CalendarContract, TimeOfDay_ReadsTheClockFace) {
    EXPECT_EQ(calendar->timeOfDay({kMoment}), (TimeOfDay{12, 34, 56}));
    EXPECT_EQ(calendar->timeOfDay({0.0}), (TimeOfDay{0, 0, 0}));
}

TEST_P(CalendarContract, TimeOfDay_OfAFractionIsTheSecondUnderWay) {
    EXPECT_EQ(calendar->timeOfDay({kMoment + 0.999}), (TimeOfDay{12, 34, 56}));
}

TEST_P(CalendarContract, TimeOfDay_BeforeTheReferenceDate) {
    EXPECT_EQ(calendar->timeOfDay({-1.0}), (TimeOfDay{23, 59, 59}));
    EXPECT_EQ(calendar->timeOfDay({-0.25}), (TimeOfDay{23, 59, 59}));
}

TEST_P(CalendarContract, SubtractingTheTimeOfDay_GivesMidnightAndKeepsTheFraction) {
    const Date date{kMoment + 0.375};
    const auto time = calendar->timeOfDay(date);
    EXPECT_EQ(calendar->adding({-time.hour, -time.minute, -time.second}, date), Date{790128000.0 + 0.375});
}

TEST_P(CalendarContract, AddingNothing_GivesTheDate) {
    EXPECT_EQ(calendar->adding({}, {kMoment + 0.5}), Date{kMoment + 0.5});
}

TEST_P(CalendarContract, AmountsCarryOverAndMayPointEitherWay) {
    EXPECT_EQ(calendar->adding({25, 70, -10}, {kMoment}), Date{kMoment + 25 * 3600.0 + 70 * 60.0 - 10.0});
}

INSTANTIATE_TEST_SUITE_P(UtcCalendar, CalendarContract,
                         ::testing::Values(CalendarCase{"UtcCalendar", [] { return std::make_shared<UtcCalendar>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
