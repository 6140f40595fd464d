#include "server/rules/NamedPlace.h"

#include <gtest/gtest.h>

#include <cmath>

namespace ktr::test {

using server::Fix;
using server::NamedPlace;

namespace {

constexpr double kDegree = 111250.0;  // metres along a meridian at this latitude, to a thousandth

NamedPlace work(double radius) {
    return {1, "Work", "work", 50.0, -3.0, radius, true};
}
Fix north(double metres, std::optional<double> accuracy = std::nullopt) {
    return {0, 0, 50.0 + metres / kDegree, -3.0, accuracy};
}

}  // namespace

TEST(NamedPlaceTest, Circle_HoldsWhatIsWithinItsRadius) {
    EXPECT_TRUE(work(150.0).holds(north(0.0)));
    EXPECT_TRUE(work(150.0).holds(north(149.0)));
    EXPECT_TRUE(work(150.0).holds(north(-149.0)));
    EXPECT_FALSE(work(150.0).holds(north(151.0)));
    EXPECT_FALSE(work(150.0).holds({0, 0, 50.0, -3.0023, std::nullopt})) << "to the west";
    EXPECT_TRUE(work(150.0).holds({0, 0, 50.0, -3.0020, std::nullopt}));
}

TEST(NamedPlaceTest, FixThatIsTooVague_IsHeldByNone) {
    EXPECT_TRUE(work(150.0).holds(north(0.0, 200.0)));
    EXPECT_FALSE(work(150.0).holds(north(0.0, 201.0)));
    EXPECT_TRUE(work(500.0).holds(north(0.0, 500.0)));
    EXPECT_FALSE(work(500.0).holds(north(0.0, 501.0)));
}

TEST(NamedPlaceTest, DateLine_IsNoEdge) {
    const NamedPlace place{1, "Pier", "", 0.0, 180.0, 150.0, true};
    EXPECT_TRUE(place.holds({0, 0, 0.0, -179.9995, std::nullopt}));
}

TEST(NamedPlaceTest, APhonesPlace_IsNotSaid) {
    const auto place = NamedPlace::of({" Allotment ", 50.2, -3.1, 80.0});
    EXPECT_EQ(place, (NamedPlace{0, "Allotment", "", 50.2, -3.1, NamedPlace::kLeastRadius, false}));
    EXPECT_EQ(NamedPlace::of({"Home", 50.2, -3.1, 300.0}), (NamedPlace{0, "Home", "home", 50.2, -3.1, 300.0, false}));
    EXPECT_EQ(NamedPlace::of({"A", 1.0, 2.0, 1.0e9})->radius, NamedPlace::kMostRadius);
    for (const std::optional<double> radius : {std::optional<double>(), std::optional(0.0), std::optional(-5.0)}) {
        EXPECT_EQ(NamedPlace::of({"A", 1.0, 2.0, radius})->radius, 150.0);
    }
}

TEST(NamedPlaceTest, WhatIsNoPlaceOnAPhone_IsNone) {
    EXPECT_FALSE(NamedPlace::of({"", 1.0, 2.0, 100.0}));
    EXPECT_FALSE(NamedPlace::of({"   ", 1.0, 2.0, 100.0}));
    EXPECT_FALSE(NamedPlace::of({"A\nB", 1.0, 2.0, 100.0}));
    EXPECT_FALSE(NamedPlace::of({std::string(41, 'a'), 1.0, 2.0, 100.0}));
    EXPECT_FALSE(NamedPlace::of({"A", 91.0, 2.0, 100.0}));
    EXPECT_FALSE(NamedPlace::of({"A", 1.0, 181.0, 100.0}));
    EXPECT_FALSE(NamedPlace::of({"A", std::nan(""), 2.0, 100.0}));
}

TEST(NamedPlaceTest, Labels_AreTheFiveThatClientsWord) {
    for (const char* word : {"home", "work", "school", "gym", "other"}) {
        EXPECT_TRUE(NamedPlace::isLabel(word)) << word;
    }
    EXPECT_FALSE(NamedPlace::isLabel("Home"));
    EXPECT_FALSE(NamedPlace::isLabel(""));
}

}  // namespace ktr::test
