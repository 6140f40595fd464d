#include "server/rules/NamedPlace.h"

#include <gtest/gtest.h>

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

TEST(NamedPlaceTest, Labels_AreTheFiveThatClientsWord) {
    for (const char* word : {"home", "work", "school", "gym", "other"}) {
        EXPECT_TRUE(NamedPlace::isLabel(word)) << word;
    }
    EXPECT_FALSE(NamedPlace::isLabel("Home"));
    EXPECT_FALSE(NamedPlace::isLabel(""));
}

}  // namespace ktr::test
