#include "platform/map/MapViewport.h"

#include <gtest/gtest.h>

namespace ktr::test {
namespace {

using platform::Coordinate;
using platform::MapViewport;
using platform::Point;

TEST(MapViewportTest, CentreStandsInTheMiddle) {
    const MapViewport view{{50.21, -5.1}, 15.3, {400.0, 219.0}};
    const Point point = view.pointFor({50.21, -5.1});
    EXPECT_NEAR(point.x, 200.0, 1e-9);
    EXPECT_NEAR(point.y, 109.5, 1e-9);
}

TEST(MapViewportTest, WholeWorldAtZoomZero_IsASquareOf256) {
    const MapViewport view{{0.0, 0.0}, 0.0, {256.0, 256.0}};
    EXPECT_NEAR(view.coordinateAt({0.0, 0.0}).latitude, 85.05112877980659, 1e-9);
    EXPECT_NEAR(view.coordinateAt({0.0, 0.0}).longitude, -180.0, 1e-9);
    EXPECT_NEAR(view.pointFor({-85.05112877980659, 0.0}).y, 256.0, 1e-9);
}

TEST(MapViewportTest, PointAndCoordinate_AreInverse) {
    const MapViewport view{{-33.9, 151.2}, 11.7, {680.0, 389.0}};
    const Coordinate there = view.coordinateAt({17.0, 301.0});
    EXPECT_NEAR(view.pointFor(there).x, 17.0, 1e-6);
    EXPECT_NEAR(view.pointFor(there).y, 301.0, 1e-6);
}

TEST(MapViewportTest, AcrossTheAntimeridian_NearestCopyIsTaken) {
    const MapViewport view{{0.0, 179.9}, 8.0, {400.0, 200.0}};
    EXPECT_GT(view.pointFor({0.0, -179.9}).x, 200.0);
    EXPECT_LT(view.pointFor({0.0, -179.9}).x, 400.0);
}

TEST(MapViewportTest, Pole_IsMercatorsLastLatitude) {
    const MapViewport view{{80.0, 0.0}, 3.0, {400.0, 200.0}};
    EXPECT_EQ(view.pointFor({90.0, 0.0}).y, view.pointFor({86.0, 0.0}).y);
}

TEST(MapViewportTest, MetresPerPoint_ShrinkWithTheLatitude) {
    const MapViewport equator{{0.0, 0.0}, 0.0, {256.0, 256.0}};
    const MapViewport sixty{{60.0, 0.0}, 0.0, {256.0, 256.0}};
    EXPECT_NEAR(equator.metresPerPoint(), 156543.03392804097, 1e-6);
    EXPECT_NEAR(sixty.metresPerPoint(), 156543.03392804097 / 2.0, 1e-6);
}

}  // namespace
}  // namespace ktr::test
