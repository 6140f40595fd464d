#include "linux/positions/FixPolicy.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace ktr::linux_ {

namespace {

using Fix = platform::PlatformLocation::Fix;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNoNumber = std::nan("");

Fix plain() {
    Fix fix;
    fix.coordinate = {50.2104, -3.1204};
    fix.altitude = 12.0;
    fix.horizontalAccuracy = 5.0;
    fix.verticalAccuracy = 8.0;
    fix.course = 270.0;
    fix.speed = 1.5;
    fix.timestamp = platform::Date{700'000'000.0};
    return fix;
}

Fix with(double Fix::*member, double value) {
    Fix fix = plain();
    fix.*member = value;
    return fix;
}

}  // namespace

TEST(FixPolicyTest, APlausibleFix_StaysAsItIs) {
    EXPECT_EQ(FixPolicy::checked(plain()), plain());
    for (const double accuracy : {0.0, 25'000.0, FixPolicy::kMostAccuracy}) {
        EXPECT_TRUE(FixPolicy::checked(with(&Fix::horizontalAccuracy, accuracy))) << accuracy;
    }
}

TEST(FixPolicyTest, AnAccuracyThatIsNone_MakesNoPosition) {
    for (const double accuracy : {-1.0, -1e-9, 1e300, FixPolicy::kMostAccuracy + 1.0, kInfinity, kNoNumber}) {
        EXPECT_FALSE(FixPolicy::checked(with(&Fix::horizontalAccuracy, accuracy))) << accuracy;
    }
}

TEST(FixPolicyTest, APlaceOnNoEarth_MakesNoPosition) {
    for (const platform::Coordinate& place :
         {platform::Coordinate{90.1, 0.0}, platform::Coordinate{0.0, -180.1}, platform::Coordinate{kNoNumber, 0.0}}) {
        Fix fix = plain();
        fix.coordinate = place;
        EXPECT_FALSE(FixPolicy::checked(fix));
    }
}

TEST(FixPolicyTest, WhatElseCannotBe_IsUnknown) {
    for (const double odd : {-2.0, 1e300, kInfinity, kNoNumber}) {
        EXPECT_EQ(FixPolicy::checked(with(&Fix::course, odd))->course, -1.0);
        EXPECT_EQ(FixPolicy::checked(with(&Fix::speed, odd))->speed, -1.0);
        const auto flat = FixPolicy::checked(with(&Fix::verticalAccuracy, odd));
        EXPECT_EQ(flat->verticalAccuracy, -1.0);
        EXPECT_EQ(flat->horizontalAccuracy, 5.0);
    }
    for (const double odd : {-1e300, 1e300, kNoNumber}) {
        const auto flat = FixPolicy::checked(with(&Fix::altitude, odd));
        EXPECT_EQ(flat->altitude, 0.0);
        EXPECT_EQ(flat->verticalAccuracy, -1.0);
    }
    Fix timeless = plain();
    timeless.timestamp = platform::Date{kNoNumber};
    EXPECT_EQ(FixPolicy::checked(timeless)->timestamp, std::nullopt);
}

}  // namespace ktr::linux_
