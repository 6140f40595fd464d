// The region that a map shows, and the pictures it asks for.
#include "platform/map/PlatformMapView.h"

#include <cmath>

#include "tests/unit/map/PlatformMapViewFixture.h"

namespace ktr::test {

using namespace platform;

TEST_F(PlatformMapViewTest, WithoutARegion_PlainGroundAndWords) {
    localization->set("org.ktr.host", "MAP_NO_PLACE", "No place to show");
    EXPECT_FALSE(map_->requestedRegion());
    const auto canvas = painted();
    time->runPosted();
    EXPECT_EQ(maps_->requests.size(), 0u) << "no map of the world for somebody who has no place";
    ASSERT_EQ(count(canvas, RecordingCanvas::Call::Kind::Text), 1u);
    const auto words = std::find_if(canvas.calls.begin(), canvas.calls.end(),
                                    [](const auto& call) { return call.kind == RecordingCanvas::Call::Kind::Text; });
    EXPECT_NEAR(words->rect.x + words->rect.width / 2.0, 188.0, 0.01);
}

TEST_F(PlatformMapViewTest, FirstRegion_IsThereAtOnce) {
    map_->setRegion(kTown, true);
    EXPECT_EQ(map_->viewport(), kTown.viewport({376.0, 219.0}));
    EXPECT_EQ(map_->requestedRegion(), kTown);
    EXPECT_GE(map_->region().span.latitudeDelta, 0.01 - 1e-9);
}

TEST_F(PlatformMapViewTest, InvalidCentre_IsIgnored) {
    map_->setRegion({{91.0, 0.0}, {1.0, 1.0}}, false);
    EXPECT_FALSE(map_->requestedRegion());
}

TEST_F(PlatformMapViewTest, LaterAnimatedRegion_IsGlidedTo) {
    map_->setRegion(kTown, false);
    time->runUntilIdle(1.0);
    const MapViewport before = map_->viewport();
    map_->setRegion({{50.22, -3.12}, {0.02, 0.02}}, true);
    EXPECT_EQ(map_->viewport(), before);
    time->advance(0.2);
    EXPECT_GT(map_->viewport().centre.latitude, 50.21);
    EXPECT_LT(map_->viewport().centre.latitude, 50.22);
    EXPECT_LT(map_->viewport().zoom, before.zoom);
    time->advance(0.4);
    EXPECT_EQ(map_->viewport(), map_->viewportAtRest());
}

TEST_F(PlatformMapViewTest, ReducedMotion_IsThereAtOnce) {
    map_->setRegion(kTown, false);
    appearance->reducedMotion = true;
    map_->setRegion({{50.22, -3.12}, {0.02, 0.02}}, true);
    EXPECT_EQ(map_->viewport(), map_->viewportAtRest());
}

TEST_F(PlatformMapViewTest, TheSameRegionAgain_ChangesNothing) {
    map_->setRegion(kTown, false);
    time->runUntilIdle(1.0);
    const auto asked = maps_->requests.size();
    map_->setRegion(kTown, true);
    map_->setNeedsLayout();
    map_->layoutIfNeeded();
    time->runUntilIdle(1.0);
    EXPECT_EQ(maps_->requests.size(), asked);
    EXPECT_EQ(time->pendingTimers(), 0u);
}

TEST_F(PlatformMapViewTest, AcrossTheAntimeridian_GlidesTheShortWay) {
    map_->setRegion({{0.0, 179.9}, {0.5, 0.5}}, false);
    map_->setRegion({{0.0, -179.9}, {0.5, 0.5}}, true);
    for (int i = 0; i < 10; ++i) {
        time->advance(0.04);
        EXPECT_GT(std::abs(map_->viewport().centre.longitude), 179.8);
    }
}

// Pictures of the ground

TEST_F(PlatformMapViewTest, Gliding_AsksForTheTargetOnlyAndDrawsWhatThereIs) {
    map_->setRegion(kTown, false);
    time->runPosted();
    const auto first = maps_->answer();
    map_->setRegion({{50.211, -3.12}, {0.01, 0.01}}, true);
    time->runPosted();
    const auto asked = maps_->requests.size();
    EXPECT_EQ(maps_->requests.back().viewport, map_->viewportAtRest());
    time->advance(0.2);
    const auto canvas = painted();
    EXPECT_EQ(maps_->requests.size(), asked);
    const auto picture = std::find_if(canvas.calls.begin(), canvas.calls.end(),
                                      [&](const auto& call) { return call.object == first.get(); });
    ASSERT_NE(picture, canvas.calls.end());
    EXPECT_GT(picture->rect.y, 0.5) << "the ground moves down while the map goes north";
    EXPECT_NEAR(picture->rect.height, 219.0, 0.1);
}

TEST_F(PlatformMapViewTest, AnotherWayWhileGliding_NoEdgeIsLeftBare) {
    for (const double latitude : {50.21, 50.211, 50.212}) {
        map_->setRegion({{latitude, -3.12}, {0.01, 0.01}}, true);
        time->runPosted();
        maps_->answer();
        time->advance(0.02);
    }
    const auto canvas = painted();
    EXPECT_EQ(count(canvas, RecordingCanvas::Call::Kind::Image), 3U);
    EXPECT_TRUE(std::any_of(canvas.calls.begin(), canvas.calls.end(),
                            [](const auto& call) { return call.object && call.rect.maxY() >= 219.0 - 1e-6; }));
}

TEST_F(PlatformMapViewTest, AtRest_TheLatestPictureAloneFillsTheMap) {
    map_->setRegion(kTown, false);
    time->runPosted();
    maps_->answer();
    map_->setRegion({{50.211, -3.12}, {0.01, 0.01}}, true);
    time->runUntilIdle(1.0);
    const auto last = maps_->answer();
    time->runUntilIdle(1.0);
    const auto canvas = painted();
    EXPECT_EQ(count(canvas, RecordingCanvas::Call::Kind::Image), 1u);
    const auto picture = std::find_if(canvas.calls.begin(), canvas.calls.end(),
                                      [&](const auto& call) { return call.object == last.get(); });
    ASSERT_NE(picture, canvas.calls.end());
    EXPECT_EQ(picture->rect, (Rect{0.0, 0.0, 376.0, 219.0}));
}

TEST_F(PlatformMapViewTest, StaleRequests_AreCancelled) {
    map_->setRegion(kTown, false);
    time->runPosted();
    map_->setRegion({{50.3, -3.12}, {0.01, 0.01}}, false);
    time->runPosted();
    EXPECT_EQ(maps_->waiting.size(), 1u);
    EXPECT_EQ(maps_->cancelled.size(), maps_->requests.size() - 1);
    map_ = nullptr;
    EXPECT_TRUE(maps_->waiting.empty());
}

TEST_F(PlatformMapViewTest, TheSourcesChanges_AreAskedForOnceTheAnswerIsThere) {
    map_->setRegion(kTown, false);
    time->runPosted();
    const auto asked = maps_->requests.size();
    maps_->change();
    maps_->change();
    EXPECT_EQ(maps_->requests.size(), asked);
    maps_->answer();
    EXPECT_EQ(maps_->requests.size(), asked + 1);
    maps_->answer();
    maps_->change();
    EXPECT_EQ(maps_->requests.size(), asked + 2);
}

TEST_F(PlatformMapViewTest, AppearanceChange_AsksForAnotherPicture) {
    map_->setRegion(kTown, false);
    time->runPosted();
    EXPECT_FALSE(maps_->requests.back().isDark);
    EXPECT_EQ(maps_->requests.back().scale, 2.0);
    EXPECT_EQ(maps_->requests.back().language, "en-GB");
    appearance->dark = true;
    appearance->highContrast = true;
    platform->notificationCenter->post({kAppearanceChangedNotification, nullptr});
    time->runPosted();
    EXPECT_TRUE(maps_->requests.back().isDark);
    EXPECT_TRUE(maps_->requests.back().isHighContrast);
}

TEST_F(PlatformMapViewTest, Labels_KeepClearOfPinsAndCorners) {
    const auto pin = std::make_shared<Pin>();
    map_->addAnnotation(pin);
    map_->setRegion(kTown, false);
    time->runPosted();
    const auto& clear = maps_->requests.back().clear;
    ASSERT_EQ(clear.size(), 3u);
    EXPECT_TRUE(clear[0].contains({188.0, 108.0}));
    EXPECT_TRUE(clear[0].contains({188.0, 70.0}));
    EXPECT_TRUE(clear[1].contains({20.0, 205.0}));
    EXPECT_TRUE(clear[2].contains({360.0, 205.0}));
}

TEST_F(PlatformMapViewTest, WhereThePinIs_TheCornerGivesWay) {
    const auto pin = std::make_shared<Pin>();
    map_->setRegion(kTown, false);
    pin->place = map_->viewport().coordinateAt({50.0, 205.0});
    map_->addAnnotation(pin);
    time->runPosted();
    const auto& clear = maps_->requests.back().clear;
    ASSERT_EQ(clear.size(), 3u);
    EXPECT_TRUE(clear[1].contains({20.0, 20.0}));
    EXPECT_TRUE(clear[2].contains({360.0, 205.0}));
}

TEST_F(PlatformMapViewTest, RightToLeft_CornersChangeSides) {
    assistant->rightToLeft = true;
    map_->setRegion(kTown, false);
    time->runPosted();
    const auto& clear = maps_->requests.back().clear;
    ASSERT_EQ(clear.size(), 2u);
    EXPECT_TRUE(clear[0].contains({356.0, 205.0}));
    EXPECT_TRUE(clear[1].contains({20.0, 205.0}));
}

TEST_F(PlatformMapViewTest, WithoutASource_PlainLandAndWords) {
    platform->maps = nullptr;
    localization->set("org.ktr.host", "MAP_NOT_AVAILABLE", "Map not available");
    const auto bare = create<PlatformMapView>(&PlatformMapView::initWithFrame, Rect{0.0, 0.0, 376.0, 219.0});
    bare->setRegion(kTown, false);
    bare->layoutIfNeeded();
    RecordingCanvas canvas;
    bare->paint(canvas, bare->bounds());
    ASSERT_EQ(canvas.calls.size(), 2u);
    EXPECT_EQ(canvas.calls[0].color, Color::ofRole(ColorRole::MapLand));
    EXPECT_EQ(canvas.calls[1].kind, RecordingCanvas::Call::Kind::Text);
    EXPECT_NEAR(canvas.calls[1].rect.x + canvas.calls[1].rect.width / 2.0, 188.0, 0.01);
}

TEST_F(PlatformMapViewTest, Attribution_StandsInItsPill) {
    map_->setRegion(kTown, false);
    time->runPosted();
    maps_->answer();
    time->runPosted();
    const auto canvas = painted();
    const auto pill = std::find_if(canvas.calls.begin(), canvas.calls.end(), [](const auto& call) {
        return call.color == Color::ofRole(ColorRole::MapAttributionPill);
    });
    ASSERT_NE(pill, canvas.calls.end());
    EXPECT_NEAR(pill->rect.maxX(), 376.0 - 8.0, 1e-6);
    EXPECT_NEAR(pill->rect.maxY(), 219.0 - 6.0, 1e-6);
    EXPECT_NEAR(pill->rect.height, 18.0, 1e-6);
    EXPECT_NEAR(pill->rect.width, 8.0 * 11.0 + 16.0, 1e-6);
}

TEST_F(PlatformMapViewTest, LongAttribution_IsWholeAndLiftsTheScale) {
    maps_->attribution = "A very long list of those who have drawn this map, all of them";
    map_->setRegion(kTown, false);
    time->runPosted();
    maps_->answer();
    time->runPosted();
    const auto canvas = painted();
    const auto find = [&](ColorRole role) {
        return std::find_if(canvas.calls.begin(), canvas.calls.end(),
                            [&](const auto& call) { return call.color == Color::ofRole(role); });
    };
    const auto pill = find(ColorRole::MapAttributionPill);
    const auto words = find(ColorRole::MapAttribution);
    const auto scale = find(ColorRole::MapScale);
    ASSERT_NE(pill, canvas.calls.end());
    ASSERT_NE(words, canvas.calls.end());
    ASSERT_NE(scale, canvas.calls.end());
    EXPECT_GE(pill->rect.x, 0.0);
    EXPECT_GT(pill->rect.height, 18.0);
    EXPECT_LE(words->rect.maxX(), pill->rect.maxX());
    EXPECT_LE(scale->rect.maxY(), pill->rect.y);
}

}  // namespace ktr::test
