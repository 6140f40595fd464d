#include "views/KTRVAMapAnnotation.h"

#include "model/KTRVATheme.h"
#include "platform/map/KTAnnotationView.h"
#include "tests/support/PlatformTest.h"
#include "views/KTRVAMapDelegate.h"

namespace ktr {

using namespace platform;

namespace {

std::shared_ptr<VALocation> at(std::optional<double> latitude, std::optional<double> longitude) {
    auto location = std::make_shared<VALocation>();
    location->latitude = latitude;
    location->longitude = longitude;
    return location;
}

}  // namespace

class KTRVAMapAnnotationTest : public test::PlatformTest {
  protected:
    std::shared_ptr<PlatformMapView> makeMap() {
        return create<PlatformMapView>(&PlatformMapView::initWithFrame, Rect{0.0, 0.0, 376.0, 219.0});
    }
    std::shared_ptr<KTRVAMapDelegate> delegate_ = KTRVAMapDelegate::sharedInstance();
};

TEST_F(KTRVAMapAnnotationTest, Made_HasTheLocationsCoordinate) {
    const auto place = at(50.0, -3.0);
    const auto pin = KTRVAMapAnnotation::annotationWithLocation(place);
    EXPECT_EQ(pin->location(), place);
    EXPECT_EQ(pin->coordinate(), (Coordinate{50.0, -3.0}));
    EXPECT_EQ(pin->title(), std::nullopt);
    EXPECT_EQ(pin->subtitle(), std::nullopt);
    EXPECT_FALSE(pin->isFenceAnnotation());
    EXPECT_FALSE(pin->isBorderEnabled());
    EXPECT_FALSE(pin->isThisDevice());
    EXPECT_EQ(pin->distanceFromUser(), 0.0);
    EXPECT_EQ(pin->horizontalAccuracy(), 0.0);
    EXPECT_EQ(pin->overlay(), nullptr);
    EXPECT_EQ(pin->largeOverlayIcon(), nullptr);
    EXPECT_EQ(pin->smallOverlayIcon(), nullptr);
}

TEST_F(KTRVAMapAnnotationTest, MissingDegrees_ReadAsZero) {
    EXPECT_EQ(KTRVAMapAnnotation::annotationWithLocation(nullptr)->coordinate(), Coordinate{});
    EXPECT_EQ(KTRVAMapAnnotation::annotationWithLocation(at(5.0, std::nullopt))->coordinate(), (Coordinate{5.0, 0.0}));
}

TEST_F(KTRVAMapAnnotationTest, KnownLocation_NeedsBothAndNeitherZero) {
    EXPECT_TRUE(KTRVAMapAnnotation::annotationWithLocation(at(1.0, 2.0))->hasKnownLocation());
    EXPECT_FALSE(KTRVAMapAnnotation::annotationWithLocation(at(0.0, 2.0))->hasKnownLocation());
    EXPECT_FALSE(KTRVAMapAnnotation::annotationWithLocation(at(1.0, 0.0))->hasKnownLocation());
    EXPECT_FALSE(KTRVAMapAnnotation::annotationWithLocation(at(std::nullopt, 2.0))->hasKnownLocation());
    EXPECT_FALSE(KTRVAMapAnnotation::annotationWithLocation(nullptr)->hasKnownLocation());
}

TEST_F(KTRVAMapAnnotationTest, SetLocation_IsAnAnimationOfHalfASecond) {
    const auto pin = KTRVAMapAnnotation::annotationWithLocation(at(1.0, 2.0));
    double duration = 0.0;
    const auto token = pin->observeCoordinate([&] { duration = Animation::currentDuration(); });
    pin->setLocation(at(3.0, 4.0));
    EXPECT_EQ(duration, 0.5);
    EXPECT_EQ(pin->coordinate(), (Coordinate{3.0, 4.0}));
}

TEST_F(KTRVAMapAnnotationTest, TheSameLocationAgain_IsAppliedAgain_IsKept) {
    const auto place = at(1.0, 2.0);
    const auto pin = KTRVAMapAnnotation::annotationWithLocation(place);
    place->latitude = 5.0;
    int changes = 0;
    const auto token = pin->observeCoordinate([&] { ++changes; });
    pin->setLocation(place);
    EXPECT_EQ(changes, 1);
    EXPECT_EQ(pin->coordinate(), (Coordinate{5.0, 2.0}));
}

TEST_F(KTRVAMapAnnotationTest, Destroyed_LetsGoOfItsLocation) {
    const auto place = at(1.0, 2.0);
    auto pin = KTRVAMapAnnotation::annotationWithLocation(place);
    pin.reset();
    EXPECT_EQ(place.use_count(), 1);
}

// The delegate

TEST_F(KTRVAMapAnnotationTest, Delegate_IsOneForAllMaps) {
    EXPECT_EQ(KTRVAMapDelegate::sharedInstance(), delegate_);
    Platform::install(nullptr);
    EXPECT_EQ(KTRVAMapDelegate::sharedInstance(), nullptr);
}

TEST_F(KTRVAMapAnnotationTest, Friend_GetsAPinInOrange) {
    const auto pin = KTRVAMapAnnotation::annotationWithLocation(at(1.0, 2.0));
    const auto view = std::dynamic_pointer_cast<KTAnnotationView>(delegate_->viewForAnnotation(*makeMap(), pin));
    ASSERT_NE(view, nullptr);
    EXPECT_EQ(view->tintColor(), KTRVATheme::ktrOrangeColor());
    EXPECT_EQ(view->annotation(), pin);
    EXPECT_EQ(view->reuseIdentifier(), "KTRVAMapDelegate");
    EXPECT_FALSE(view->canShowCallout());
    EXPECT_FALSE(view->enabled());
}

TEST_F(KTRVAMapAnnotationTest, Fence_GetsARedMarkerOfTheSameIdentifier) {
    const auto pin = KTRVAMapAnnotation::annotationWithLocation(at(1.0, 2.0));
    pin->setIsFenceAnnotation(true);
    const auto view = std::dynamic_pointer_cast<MarkerAnnotationView>(delegate_->viewForAnnotation(*makeMap(), pin));
    ASSERT_NE(view, nullptr);
    EXPECT_EQ(view->markerTintColor(), Color::systemRed());
    EXPECT_EQ(view->reuseIdentifier(), "KTRVAMapDelegate");
    EXPECT_FALSE(view->enabled());
}

TEST_F(KTRVAMapAnnotationTest, AFreeViewOfTheOtherKind_OnlyGetsTheAnnotation_IsKept) {
    const auto map = makeMap();
    map->setDelegate(delegate_);
    const auto fence = KTRVAMapAnnotation::annotationWithLocation(at(1.0, 2.0));
    fence->setIsFenceAnnotation(true);
    map->addAnnotation(fence);
    time->runPosted();
    const auto view = map->viewForAnnotation(*fence);
    const auto friendPin = KTRVAMapAnnotation::annotationWithLocation(at(3.0, 4.0));
    map->removeAnnotation(fence);
    map->addAnnotation(friendPin);
    time->runPosted();
    EXPECT_EQ(map->viewForAnnotation(*friendPin), view);
    EXPECT_NE(std::dynamic_pointer_cast<MarkerAnnotationView>(view), nullptr);
    EXPECT_EQ(view->annotation(), friendPin);
}

TEST_F(KTRVAMapAnnotationTest, TheUser_IsLeftToTheMap) {
    EXPECT_EQ(delegate_->viewForAnnotation(*makeMap(), std::make_shared<UserLocation>()), nullptr);
}

TEST_F(KTRVAMapAnnotationTest, Circle_IsFilledInTranslucentOrange) {
    const auto circle = std::make_shared<CircleOverlay>(Coordinate{1.0, 2.0}, 3.0);
    const auto renderer =
        std::dynamic_pointer_cast<CircleOverlayRenderer>(delegate_->rendererForOverlay(*makeMap(), circle));
    ASSERT_NE(renderer, nullptr);
    EXPECT_EQ(renderer->overlay(), circle);
    EXPECT_EQ(renderer->fillColor(), KTRVATheme::ktrOrangeColor());
    EXPECT_EQ(renderer->alpha(), 0.2);
    EXPECT_EQ(renderer->strokeColor(), std::nullopt);
}

}  // namespace ktr
