#include "app/window/friend/MapCamera.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

const platform::Coordinate kMarket{50.2155, -3.1111};

MapCamera atMarket() {
    MapCamera camera;
    camera.setSize({400.0, 600.0});
    camera.put(kMarket, {200.0, 300.0}, 15.0);
    return camera;
}

TEST(MapCameraTest, APlaceIsPutWhereItBelongs) {
    MapCamera camera = atMarket();
    camera.put(kMarket, {120.0, 480.0}, 16.0);
    const auto at = camera.shown().pointFor(kMarket);
    EXPECT_NEAR(at.x, 120.0, 1e-6);
    EXPECT_NEAR(at.y, 480.0, 1e-6);
    EXPECT_EQ(camera.shown().zoom, 16.0);
}

TEST(MapCameraTest, TheGroundFollowsTheHand) {
    MapCamera camera = atMarket();
    camera.panBy(30.0, -50.0);
    const auto at = camera.shown().pointFor(kMarket);
    EXPECT_NEAR(at.x, 230.0, 1e-6);
    EXPECT_NEAR(at.y, 250.0, 1e-6);
}

TEST(MapCameraTest, WhatIsUnderTheFingersStaysThere) {
    MapCamera camera = atMarket();
    const platform::Point fingers{90.0, 520.0};
    const auto there = camera.shown().coordinateAt(fingers);
    camera.zoomBy(1.3, fingers);
    EXPECT_NEAR(camera.shown().zoom, 16.3, 1e-9);
    EXPECT_NEAR(camera.shown().pointFor(there).x, fingers.x, 1e-6);
    EXPECT_NEAR(camera.shown().pointFor(there).y, fingers.y, 1e-6);
}

TEST(MapCameraTest, StepsAddUp_AndKeepTheirPointOnTheWay) {
    MapCamera camera = atMarket();
    const platform::Point at{100.0, 100.0};
    const auto there = camera.shown().coordinateAt(at);
    camera.zoomOn(1.0, at, 0.0, 0.2);
    EXPECT_TRUE(camera.advance(0.05));
    camera.zoomOn(1.0, at, 0.05, 0.2);
    EXPECT_TRUE(camera.advance(0.1));
    EXPECT_NEAR(camera.shown().pointFor(there).x, at.x, 1e-6);
    EXPECT_GT(camera.shown().zoom, 15.0);
    EXPECT_LT(camera.shown().zoom, 17.0);
    EXPECT_FALSE(camera.advance(0.3));
    EXPECT_NEAR(camera.shown().zoom, 17.0, 1e-9);
    EXPECT_NEAR(camera.shown().pointFor(there).y, at.y, 1e-6);
}

TEST(MapCameraTest, TheScaleAndTheWorldEnd) {
    MapCamera camera = atMarket();
    camera.zoomBy(100.0, {200.0, 300.0});
    EXPECT_EQ(camera.shown().zoom, MapCamera::kFinest);
    EXPECT_TRUE(camera.isFinest());
    camera.zoomBy(-100.0, {200.0, 300.0});
    EXPECT_EQ(camera.shown().zoom, MapCamera::kCoarsest);
    EXPECT_TRUE(camera.isCoarsest());
    for (int i = 0; i < 1000; ++i) {
        camera.panBy(500.0, 500.0);
    }
    EXPECT_LE(camera.shown().centre.latitude, 85.06);
    EXPECT_GE(camera.shown().centre.longitude, -180.0);
    EXPECT_LE(camera.shown().centre.longitude, 180.0);
}

TEST(MapCameraTest, AHandEndsAFlight) {
    MapCamera camera = atMarket();
    camera.flyTo({51.0, -3.0}, {200.0, 300.0}, 15.0, 0.0, 0.5);
    EXPECT_TRUE(camera.isMoving(0.1));
    camera.panBy(1.0, 0.0);
    EXPECT_FALSE(camera.isMoving(0.1));
    EXPECT_FALSE(camera.advance(0.2));
}

TEST(MapCameraTest, AScaleInMetresAPoint) {
    const double zoom = MapCamera::zoomFor(kMarket, 1.5);
    EXPECT_NEAR((platform::MapViewport{kMarket, zoom, {}}.metresPerPoint()), 1.5, 1e-9);
    EXPECT_EQ(MapCamera::zoomFor(kMarket, 1e9), MapCamera::kCoarsest);
}

}  // namespace

}  // namespace ktr::app
