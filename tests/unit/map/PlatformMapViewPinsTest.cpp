// What a map draws over its ground: pins, circles, the user; and what a hand does to it.
#include "platform/map/PlatformMapView.h"

#include "platform/map/MapLocationManager.h"
#include "tests/unit/map/PlatformMapViewFixture.h"

namespace ktr::test {

using namespace platform;

// Annotations

TEST_F(PlatformMapViewTest, Tip_StandsOnThePlace) {
    const auto pin = std::make_shared<Pin>();
    map_->addAnnotation(pin);
    map_->setRegion(kTown, false);
    map_->layoutIfNeeded();
    EXPECT_NEAR(tipOf(*pin).x, 188.0, 1e-6);
    EXPECT_NEAR(tipOf(*pin).y, 109.5, 1e-6);
}

TEST_F(PlatformMapViewTest, ASetCoordinate_MovesTheViewAtOnce) {
    const auto pin = std::make_shared<Pin>();
    map_->addAnnotation(pin);
    map_->setRegion(kTown, false);
    map_->layoutIfNeeded();
    pin->move(map_->viewport().coordinateAt({100.0, 50.0}));
    EXPECT_NEAR(tipOf(*pin).x, 100.0, 1e-6);
}

TEST_F(PlatformMapViewTest, SetWithinAnAnimation_TheViewGlides) {
    const auto pin = std::make_shared<Pin>();
    map_->addAnnotation(pin);
    map_->setRegion(kTown, false);
    map_->layoutIfNeeded();
    const Coordinate target = map_->viewport().coordinateAt({288.0, 109.5});
    Animation::animate(0.5, [&] { pin->move(target); });
    EXPECT_EQ(pin->coordinate(), target);
    EXPECT_NEAR(tipOf(*pin).x, 188.0, 1e-6);
    time->advance(0.2);
    EXPECT_GT(tipOf(*pin).x, 190.0);
    EXPECT_LT(tipOf(*pin).x, 287.0);
    time->advance(0.4);
    EXPECT_NEAR(tipOf(*pin).x, 288.0, 1e-6);
}

TEST_F(PlatformMapViewTest, RemovedAndAddedInOneTurn_GlidesOn) {
    const auto pin = std::make_shared<Pin>();
    map_->addAnnotation(pin);
    map_->setRegion(kTown, false);
    time->runPosted();
    const auto view = map_->viewForAnnotation(*pin);
    Animation::animate(0.5, [&] { pin->move(map_->viewport().coordinateAt({288.0, 109.5})); });
    map_->removeAnnotation(pin);
    map_->addAnnotation(pin);
    time->runPosted();
    EXPECT_EQ(map_->viewForAnnotation(*pin), view);
    EXPECT_EQ(delegate_->views, 1);
    time->advance(0.2);
    EXPECT_GT(tipOf(*pin).x, 190.0);
    EXPECT_LT(tipOf(*pin).x, 287.0);
}

TEST_F(PlatformMapViewTest, FromNowhere_NobodyGlides) {
    const auto pin = std::make_shared<Pin>();
    pin->place = {};
    map_->addAnnotation(pin);
    map_->setRegion(kTown, false);
    map_->layoutIfNeeded();
    Animation::animate(0.5, [&] { pin->move({50.21, -3.12}); });
    EXPECT_NEAR(tipOf(*pin).x, 188.0, 1e-6);
}

TEST_F(PlatformMapViewTest, FreeViews_AreUsedAgain) {
    const auto first = std::make_shared<Pin>();
    map_->addAnnotation(first);
    time->runPosted();
    const auto view = map_->viewForAnnotation(*first);
    const auto second = std::make_shared<Pin>();
    map_->removeAnnotation(first);
    map_->addAnnotation(second);
    time->runPosted();
    EXPECT_EQ(map_->viewForAnnotation(*first), nullptr);
    EXPECT_EQ(map_->viewForAnnotation(*second), view);
    EXPECT_EQ(view->annotation(), second);
    EXPECT_EQ(map_->dequeueReusableAnnotationView("pin"), nullptr);
    EXPECT_EQ(map_->dequeueReusableAnnotationView("other"), nullptr);
}

TEST_F(PlatformMapViewTest, AddedTwice_IsThereOnce) {
    const auto pin = std::make_shared<Pin>();
    map_->addAnnotation(pin);
    map_->addAnnotation(pin);
    map_->addAnnotation(nullptr);
    EXPECT_EQ(map_->annotations().size(), 1u);
    map_->removeAnnotations(map_->annotations());
    EXPECT_TRUE(map_->annotations().empty());
}

// Overlays

TEST_F(PlatformMapViewTest, Overlay_IsDrawnOverTheGroundOnItsPlace) {
    map_->setRegion(kTown, false);
    map_->addOverlay(std::make_shared<CircleOverlay>(Coordinate{50.21, -3.12}, 100.0));
    const auto canvas = painted();
    ASSERT_GE(canvas.calls.size(), 2u);
    EXPECT_EQ(canvas.calls[0].color, Color::ofRole(ColorRole::MapLand));
    EXPECT_EQ(canvas.calls[1].kind, RecordingCanvas::Call::Kind::Path);
    EXPECT_NEAR(canvas.calls[1].rect.x + canvas.calls[1].rect.width / 2.0, 188.0, 0.01);
}

TEST_F(PlatformMapViewTest, Renderers_AreAskedForOnce) {
    const auto circle = std::make_shared<CircleOverlay>(Coordinate{50.21, -3.12}, 100.0);
    map_->addOverlay(circle);
    map_->addOverlay(circle);
    time->runPosted();
    map_->addOverlay(std::make_shared<CircleOverlay>(Coordinate{50.21, -3.12}, 50.0));
    time->runPosted();
    EXPECT_EQ(delegate_->renderers, 2);
    map_->removeOverlays(map_->overlays());
    EXPECT_TRUE(map_->overlays().empty());
}

// The user

TEST_F(PlatformMapViewTest, User_IsUnknownUntilAsked) {
    EXPECT_EQ(map_->userLocation()->location(), nullptr);
    EXPECT_EQ(map_->userLocation()->coordinate(), Coordinate{});
    EXPECT_TRUE(locationManagers->made.empty());
}

TEST_F(PlatformMapViewTest, User_IsFollowedInTheBundlesName) {
    const auto bundle = std::make_shared<Bundle>("org.ktr.host");
    shared<MapLocationManager>()->setEffectiveBundle(bundle);
    locationManagers->cached = position(50.2, -3.1);
    map_->setShowsUserLocation(true);
    ASSERT_EQ(locationManagers->made.size(), 1u);
    const auto manager = locationManagers->made[0];
    EXPECT_EQ(manager->bundle, bundle);
    EXPECT_TRUE(manager->updating);
    EXPECT_EQ(map_->userLocation()->coordinate(), (Coordinate{50.2, -3.1}));
    manager->deliver(position(50.3, -3.1));
    EXPECT_EQ(map_->userLocation()->coordinate(), (Coordinate{50.3, -3.1}));
    manager->deliver(position(50.4, -3.1, -1.0));
    EXPECT_EQ(map_->userLocation()->coordinate(), (Coordinate{50.3, -3.1}));
    map_->setShowsUserLocation(false);
    EXPECT_FALSE(manager->updating);
    EXPECT_EQ(map_->userLocation()->location(), nullptr);
}

TEST_F(PlatformMapViewTest, MapGone_NobodyFollows) {
    map_->setShowsUserLocation(true);
    map_ = nullptr;
    EXPECT_FALSE(locationManagers->made[0]->updating);
}

TEST_F(PlatformMapViewTest, User_HasTheMapsOwnViewBehindThePins) {
    locationManagers->cached = position(50.21, -3.12);
    const auto pin = std::make_shared<Pin>();
    map_->addAnnotation(pin);
    time->runPosted();
    map_->setShowsUserLocation(true);
    time->runPosted();
    const auto user = map_->viewForAnnotation(*map_->userLocation());
    EXPECT_NE(std::dynamic_pointer_cast<UserLocationView>(user), nullptr);
    const auto& views = map_->subviews();
    ASSERT_EQ(views.size(), 3u);
    EXPECT_EQ(views[0], user);
    EXPECT_EQ(views[1], map_->viewForAnnotation(*pin));
}

TEST_F(PlatformMapViewTest, Halo_IsAsLargeAsThePositionIsSure) {
    locationManagers->cached = position(50.21, -3.12, 1.0);
    map_->setShowsUserLocation(true);
    map_->setRegion(kTown, false);
    time->runPosted();
    const auto view = map_->viewForAnnotation(*map_->userLocation());
    EXPECT_EQ(view->frame().width, 40.0);
    locationManagers->made[0]->deliver(position(50.2101, -3.12, 300.0));
    time->runUntilIdle(1.0);
    EXPECT_NEAR(view->frame().width, 600.0 / map_->viewport().metresPerPoint(), 0.1);
    EXPECT_LE(view->opaqueRect().width, 40.0);
}

TEST_F(PlatformMapViewTest, Taps_GoToWhatHoldsTheMap) {
    const auto holder = create<View>(&View::initWithFrame, Rect{0.0, 0.0, 376.0, 219.0});
    holder->addSubview(map_);
    EXPECT_EQ(holder->hitTest({100.0, 100.0}), holder);
}

TEST_F(PlatformMapViewTest, AHandMovesTheMapAtOnce_UntilARegionIsSetAgain) {
    map_->setRegion(kTown, false);
    time->runPosted();
    const Coordinate there{50.2155, -3.1111};
    map_->showAt(there, 15.25, PlatformMapView::Hand::Resting);
    EXPECT_EQ(map_->viewport().centre, there);
    EXPECT_EQ(map_->viewport().zoom, 15.25);
    EXPECT_EQ(map_->viewportAtRest(), map_->viewport());
    map_->showAt({95.0, 0.0}, 15.0, PlatformMapView::Hand::Resting);
    map_->showAt(there, std::nan(""), PlatformMapView::Hand::Resting);
    EXPECT_EQ(map_->viewport().centre, there);
    map_->setRegion(kTown, false);
    EXPECT_EQ(map_->viewport(), kTown.viewport({376.0, 219.0}));
}

TEST_F(PlatformMapViewTest, AHeldMapIsDrawnBeyondItsEdges_AndAsksForNothingWhileThatLasts) {
    map_->showAt({50.21, -3.12}, 15.0, PlatformMapView::Hand::Resting);
    time->runPosted();
    ASSERT_FALSE(maps_->requests.empty());
    EXPECT_EQ(maps_->requests.back().viewport.size, (Size{376.0 + 2.0 * 94.0, 219.0 + 2.0 * 54.0}));
    maps_->answer();
    time->runPosted();
    const auto asked = maps_->requests.size();
    const MapViewport start = map_->viewport();
    for (int step = 1; step <= 90; ++step) {
        map_->showAt(start.coordinateAt({188.0 + step, 109.5}), 15.0, PlatformMapView::Hand::Moving);
    }
    EXPECT_EQ(maps_->requests.size(), asked);
    map_->showAt(start.coordinateAt({188.0 + 120.0, 109.5}), 15.0, PlatformMapView::Hand::Moving);
    EXPECT_EQ(maps_->requests.size(), asked + 1);
}

TEST_F(PlatformMapViewTest, AMapThatNeverRestsGetsItsPictures) {
    map_->showAt({50.21, -3.12}, 15.0, PlatformMapView::Hand::Moving);
    time->runPosted();
    const auto asked = maps_->requests.size();
    for (int step = 1; step <= 50; ++step) {
        map_->showAt({50.21, -3.12 + step * 0.01}, 15.0, PlatformMapView::Hand::Moving);
        time->runPosted();
    }
    // One is under way all the time, and none of them was called off.
    EXPECT_EQ(maps_->requests.size(), asked);
    EXPECT_TRUE(maps_->cancelled.empty());
    maps_->answer();
    EXPECT_EQ(maps_->requests.size(), asked + 1);
    EXPECT_NEAR(maps_->requests.back().viewport.centre.longitude, -3.12 + 0.5, 1e-9);
}

TEST_F(PlatformMapViewTest, LabelsKeepClearOfWhatStandsOverTheMap_AndTheCornersMoveIn) {
    map_->setSurroundings({{10.0, 0.0, 60.0, 20.0}, {{0.0, 159.0, 376.0, 60.0}}});
    map_->showAt({50.21, -3.12}, 15.0, PlatformMapView::Hand::Resting);
    time->runPosted();
    const Rect chrome = map_->subviews().back()->frame();
    EXPECT_EQ(chrome, (Rect{0.0, 10.0, 356.0, 149.0}));
    const auto& clear = maps_->requests.back().clear;
    const auto covers = [&](Point point) {
        return std::any_of(clear.begin(), clear.end(), [&](const Rect& rect) {
            return rect.contains({point.x + 94.0, point.y + 54.0});
        });
    };
    EXPECT_TRUE(covers({100.0, 200.0}));
    EXPECT_TRUE(covers({60.0, 150.0}));  // the scale
    EXPECT_FALSE(covers({188.0, 60.0}));
}

TEST_F(PlatformMapViewTest, Names_StandOverTheCircles) {
    maps_->labels = std::make_shared<FakeImage>();
    map_->setRegion(kTown, false);
    map_->addOverlay(std::make_shared<CircleOverlay>(Coordinate{50.21, -3.12}, 100.0));
    time->runPosted();
    const auto ground = maps_->answer();
    const auto canvas = painted();
    const auto placeOf = [&](const auto& isIt) {
        return std::find_if(canvas.calls.begin(), canvas.calls.end(), isIt) - canvas.calls.begin();
    };
    const auto groundAt = placeOf([&](const auto& call) { return call.object == ground.get(); });
    const auto circleAt = placeOf([](const auto& call) { return call.kind == RecordingCanvas::Call::Kind::Path; });
    const auto namesAt = placeOf([&](const auto& call) { return call.object == maps_->labels.get(); });
    ASSERT_LT(static_cast<std::size_t>(namesAt), canvas.calls.size());
    EXPECT_LT(groundAt, circleAt);
    EXPECT_LT(circleAt, namesAt);
    EXPECT_EQ(canvas.calls[static_cast<std::size_t>(namesAt)].rect, (Rect{0.0, 0.0, 376.0, 219.0}));
}

TEST_F(PlatformMapViewTest, BeyondTheStreets_ARegionIsShownFromFartherOut_AndIsToldOnce) {
    int told = 0;
    const auto observer = platform->notificationCenter->addObserver(
        kMapStreetsChangedNotification, [&](const Notification& one) { told += one.sender == map_ ? 1 : 0; });
    map_->setRegion(kTown, false);
    const double asked = map_->viewportAtRest().zoom;
    maps_->coarseZoom = 9.0;
    time->runPosted();
    EXPECT_TRUE(map_->hasStreets());
    maps_->answer();
    time->runUntilIdle(1.0);
    EXPECT_FALSE(map_->hasStreets());
    EXPECT_EQ(map_->viewport().zoom, 9.0);
    EXPECT_EQ(map_->viewport().centre, kTown.center);
    EXPECT_EQ(map_->requestedRegion(), kTown) << "what was asked for is still that";
    maps_->answer();
    time->runUntilIdle(1.0);
    EXPECT_EQ(told, 1);
    EXPECT_EQ(maps_->requests.back().viewport.zoom, asked) << "streets may come";

    // Streets have been added.
    maps_->coarseZoom.reset();
    maps_->change();
    maps_->answer();
    time->runPosted();
    time->advance(0.2);
    EXPECT_GT(map_->viewport().zoom, 9.0);
    EXPECT_LT(map_->viewport().zoom, asked) << "it glides";
    time->advance(0.4);
    EXPECT_EQ(map_->viewport().zoom, asked);
    EXPECT_TRUE(map_->hasStreets());
    EXPECT_EQ(told, 2);
}

TEST_F(PlatformMapViewTest, WhereThereIsNoPlaceAnyMore_NobodyMissesStreets) {
    int told = 0;
    const auto observer = platform->notificationCenter->addObserver(
        kMapStreetsChangedNotification, [&](const Notification& one) { told += one.sender == map_ ? 1 : 0; });
    const auto ann = std::make_shared<Pin>();
    map_->addAnnotation(ann);
    map_->setRegion(kTown, false);
    maps_->coarseZoom = 9.0;
    time->runPosted();
    maps_->answer();
    time->runUntilIdle(1.0);
    ASSERT_FALSE(map_->hasStreets());
    ASSERT_EQ(told, 1);
    map_->removeAnnotation(ann);
    time->runUntilIdle(1.0);
    EXPECT_TRUE(map_->hasStreets());
    EXPECT_EQ(told, 2) << "whoever offers streets hears of it";
    map_->addAnnotation(ann);
    time->runUntilIdle(1.0);
    EXPECT_FALSE(map_->hasStreets());
    EXPECT_EQ(told, 3);
}

TEST_F(PlatformMapViewTest, BeyondTheStreets_AHandsMapStaysAndIsTold) {
    maps_->coarseZoom = 9.0;
    map_->showAt({50.21, -3.12}, 15.0, PlatformMapView::Hand::Moving);
    time->runPosted();
    EXPECT_EQ(maps_->requests.back().beyond, MapPictureRequest::Beyond::AsAsked);
    map_->showAt({50.21, -3.12}, 15.0, PlatformMapView::Hand::Resting);
    time->runPosted();
    maps_->answer();
    time->runUntilIdle(1.0);
    EXPECT_EQ(map_->viewport().zoom, 15.0);
    ASSERT_TRUE(map_->coarseZoom());
    EXPECT_NEAR(*map_->coarseZoom(), 9.0 - std::log2(1.5), 1e-9) << "its town may stand beyond the edges";
}

}  // namespace ktr::test
