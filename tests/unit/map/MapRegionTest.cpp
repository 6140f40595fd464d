#include "platform/map/MapRegion.h"

#include <cmath>
#include <limits>

#include "tests/support/PlatformTest.h"

namespace ktr::test {

using platform::Coordinate;
using platform::MapRegion;
using platform::MapViewport;
using platform::Size;

namespace {

constexpr Size kPhone{376.0, 219.0};

/// Whether what the viewport shows holds what was asked for around its centre.
void expectHolds(const MapViewport& view, const MapRegion& asked) {
    const double half = asked.span.latitudeDelta / 2.0;
    const double wide = asked.span.longitudeDelta / 2.0;
    const auto north = view.pointFor({asked.center.latitude + half, asked.center.longitude});
    const auto south = view.pointFor({asked.center.latitude - half, asked.center.longitude});
    const auto west = view.pointFor({asked.center.latitude, asked.center.longitude - wide});
    const auto east = view.pointFor({asked.center.latitude, asked.center.longitude + wide});
    EXPECT_GE(north.y, -1e-6);
    EXPECT_LE(south.y, view.size.height + 1e-6);
    EXPECT_GE(west.x, -1e-6);
    EXPECT_LE(east.x, view.size.width + 1e-6);
}

}  // namespace

class MapRegionTest : public PlatformTest {};

TEST_F(MapRegionTest, AroundAPlace_SpansTheDistances) {
    const MapRegion asked = MapRegion::around({51.0, -1.0}, 2000.0, 1000.0);
    EXPECT_EQ(asked.center, (Coordinate{51.0, -1.0}));
    const Coordinate north{51.0 + asked.span.latitudeDelta / 2.0, -1.0};
    const Coordinate south{51.0 - asked.span.latitudeDelta / 2.0, -1.0};
    EXPECT_NEAR(geodesy->distance(north, south), 2000.0, 0.01);
    const Coordinate west{51.0, -1.0 - asked.span.longitudeDelta / 2.0};
    const Coordinate east{51.0, -1.0 + asked.span.longitudeDelta / 2.0};
    EXPECT_NEAR(geodesy->distance(west, east), 1000.0, 0.01);
}

TEST_F(MapRegionTest, NoDistanceANegativeOneAndNaN_SpanNothing) {
    for (const double metres : {0.0, -5.0, std::nan("")}) {
        EXPECT_EQ(MapRegion::around({51.0, -1.0}, metres, metres).span, (platform::CoordinateSpan{}));
    }
    EXPECT_EQ(MapRegion::around({91.0, 0.0}, 10.0, 10.0).span, (platform::CoordinateSpan{}));
    platform->geodesy = nullptr;
    EXPECT_EQ(MapRegion::around({51.0, -1.0}, 10.0, 10.0).span, (platform::CoordinateSpan{}));
}

TEST_F(MapRegionTest, AtAPole_TheRegionEndsThere) {
    const MapRegion asked = MapRegion::around({89.0, 10.0}, 600000.0, 600000.0);
    // A degree to the pole, and 300 km southwards.
    EXPECT_NEAR(asked.span.latitudeDelta, 1.0 + 300.0 / 111.2, 0.01);
    EXPECT_LE(asked.span.longitudeDelta, 360.0);
    EXPECT_EQ(MapRegion::around({90.0, 0.0}, 1000.0, 1000.0).span.longitudeDelta, 360.0);
}

TEST_F(MapRegionTest, AsLargeAsTheWorld_IsTheWorld) {
    const MapRegion asked = MapRegion::around({0.0, 0.0}, 1e9, 1e9);
    EXPECT_DOUBLE_EQ(asked.span.latitudeDelta, 180.0);
    EXPECT_DOUBLE_EQ(asked.span.longitudeDelta, 360.0);
}

TEST_F(MapRegionTest, AtTheAntimeridian_NothingIsWide) {
    const MapRegion asked = MapRegion::around({0.0, 179.9999}, 1000.0, 1000.0);
    EXPECT_NEAR(asked.span.longitudeDelta, 1000.0 / 111195.0, 1e-5);
    const MapViewport view = asked.viewport(kPhone);
    EXPECT_NEAR(view.pointFor({0.0, 179.9999}).x, 188.0, 1e-6);
    EXPECT_GT(view.pointFor({0.0, -179.9999}).x, 188.0);
    EXPECT_LT(view.pointFor({0.0, -179.9999}).x, 376.0);
}

TEST_F(MapRegionTest, Viewport_IsTheSmallestThatHoldsTheRegion) {
    for (const Coordinate& center : {Coordinate{0.0, 0.0}, Coordinate{50.21, -3.12}, Coordinate{-54.8, -68.3},
                                     Coordinate{78.2, 15.6}, Coordinate{12.0, 179.99}}) {
        for (const double metres : {120.0, 3000.0, 90000.0, 900000.0}) {
            const MapRegion asked = MapRegion::around(center, metres, metres);
            const MapViewport view = asked.viewport(kPhone);
            expectHolds(view, asked);
            MapViewport closer = view;
            closer.zoom += 0.01;
            const auto north = closer.pointFor({center.latitude + asked.span.latitudeDelta / 2.0, center.longitude});
            const auto south = closer.pointFor({center.latitude - asked.span.latitudeDelta / 2.0, center.longitude});
            EXPECT_TRUE(north.y < 0.0 || south.y > kPhone.height);
        }
    }
}

TEST_F(MapRegionTest, Viewport_HasTheCentreInItsMiddle) {
    const MapRegion asked{{50.21, -3.12}, {20.0, 20.0}};
    const auto point = asked.viewport(kPhone).pointFor(asked.center);
    EXPECT_NEAR(point.x, 188.0, 1e-6);
    EXPECT_NEAR(point.y, 109.5, 1e-6);
}

TEST_F(MapRegionTest, ZeroAndNegativeSpans_AreTheClosestZoom) {
    EXPECT_EQ((MapRegion{{50.0, 1.0}, {0.0, 0.0}}.viewport(kPhone).zoom), 20.0);
    EXPECT_EQ((MapRegion{{50.0, 1.0}, {-1.0, -2.0}}.viewport(kPhone).zoom), 20.0);
    EXPECT_EQ((MapRegion{{50.0, 1.0}, {1e-9, 1e-9}}.viewport(kPhone).zoom), 20.0);
}

TEST_F(MapRegionTest, LargerThanTheWorld_ShowsNothingBeyondItsEdges) {
    for (const double latitude : {-89.0, 0.0, 60.0, 89.0}) {
        const MapViewport view = MapRegion{{latitude, 0.0}, {180.0, 360.0}}.viewport(kPhone);
        EXPECT_GE(view.pointFor({-90.0, 0.0}).y, kPhone.height - 1e-6);
        EXPECT_LE(view.pointFor({90.0, 0.0}).y, 1e-6);
        EXPECT_NEAR(256.0 * std::exp2(view.zoom), kPhone.width, 1e-6);
    }
}

TEST_F(MapRegionTest, NearAPole_TheMiddleGivesWay) {
    const MapViewport view = MapRegion{{85.0, 20.0}, {1.0, 1.0}}.viewport(kPhone);
    EXPECT_LT(view.centre.latitude, 85.0);
    EXPECT_LE(view.pointFor({90.0, 20.0}).y, 1e-6);
    EXPECT_EQ(view.centre.longitude, 20.0);
}

TEST_F(MapRegionTest, WithoutASize_NothingIsShown) {
    EXPECT_EQ((MapRegion{{50.0, 1.0}, {1.0, 1.0}}.viewport({0.0, 219.0}).zoom), 0.0);
}

TEST_F(MapRegionTest, OfAViewport_IsWhatItShows) {
    const MapRegion asked = MapRegion::of({{50.0, 1.0}, 12.0, kPhone});
    EXPECT_NEAR(asked.span.longitudeDelta, 376.0 / (256.0 * 4096.0) * 360.0, 1e-9);
    EXPECT_NEAR(asked.viewport(kPhone).zoom, 12.0, 0.01);
}

}  // namespace ktr::test
