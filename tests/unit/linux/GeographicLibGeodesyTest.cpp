#include "linux/positions/GeographicLibGeodesy.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <random>

namespace ktr::linux_ {

namespace {

using platform::Coordinate;

// From a few centimetres to the other side of the earth, everywhere on it.
TEST(GeographicLibGeodesyTest, Bounds_HoldWhatIsMeasured) {
    const GeographicLibGeodesy geodesy;
    std::mt19937 random(16);
    std::uniform_real_distribution<double> unit(-1.0, 1.0);
    int told = 0;
    for (const double degrees : {1e-7, 1e-5, 1e-3, 0.1, 3.0, 60.0, 180.0}) {
        for (int i = 0; i < 5000; ++i) {
            const Coordinate from{90.0 * unit(random), 180.0 * unit(random)};
            const Coordinate to{std::clamp(from.latitude + degrees * unit(random), -90.0, 90.0),
                                std::remainder(from.longitude + degrees * unit(random), 360.0)};
            const auto bounds = geodesy.distanceBounds(from, to);
            if (!bounds) {
                continue;
            }
            ++told;
            const double metres = geodesy.distance(from, to);
            ASSERT_GE(metres, bounds->least) << from.latitude << " " << from.longitude << ", " << degrees;
            ASSERT_LE(metres, bounds->most) << from.latitude << " " << from.longitude << ", " << degrees;
            ASSERT_LE(bounds->most - bounds->least, 2.1e-5 * metres + 1e-5);
        }
    }
    EXPECT_GT(told, 33000) << "nearly all of them";
}

TEST(GeographicLibGeodesyTest, Bounds_AreNoneForWhatLiesOpposite) {
    const GeographicLibGeodesy geodesy;
    EXPECT_EQ(geodesy.distanceBounds({0.0, 0.0}, {0.2, 179.8}), std::nullopt);
    EXPECT_EQ(geodesy.distanceBounds({90.0, 0.0}, {-90.0, 0.0}), std::nullopt);
    EXPECT_NE(geodesy.distanceBounds({50.0, 179.9}, {50.0, -179.9}), std::nullopt);
}

TEST(GeographicLibGeodesyTest, Bounds_AreNoneForNoPlaces) {
    const GeographicLibGeodesy geodesy;
    EXPECT_EQ(geodesy.distanceBounds({NAN, 8.0}, {50.0, 8.0}), std::nullopt);
    EXPECT_EQ(geodesy.distanceBounds({50.0, 8.0}, {91.0, 8.0}), std::nullopt);
}

TEST(GeographicLibGeodesyTest, Bounds_OfOnePlace_AreNothing) {
    const auto bounds = GeographicLibGeodesy().distanceBounds({50.0, 8.0}, {50.0, 8.0});
    ASSERT_NE(bounds, std::nullopt);
    EXPECT_GE(bounds->least, 0.0);
    EXPECT_LE(bounds->most, 1e-5);
}

}  // namespace

}  // namespace ktr::linux_
