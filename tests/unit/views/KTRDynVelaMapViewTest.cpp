#include "views/KTRDynVelaMapView.h"

#include "model/KTRVATheme.h"
#include "platform/map/KTAnnotationView.h"
#include "tests/support/MapTest.h"
#include "views/KTRVAMapDelegate.h"

// Pins, circles and taps; which part of the world is shown is in KTRDynVelaMapViewRegionTest.cpp.

namespace ktr {

using namespace platform;
using test::contactWith;
using test::friendByEmail;
using test::friendByPhone;
using test::PatientShifter;
using test::placed;

using Circles = std::vector<std::pair<Coordinate, double>>;

namespace {

constexpr Coordinate kAnn{51.0, -1.0};

struct OtherPin : MapAnnotation {
    Coordinate coordinate() const override { return {1.0, 1.0}; }
};

struct OtherOverlay : MapOverlay {
    Coordinate coordinate() const override { return {1.0, 1.0}; }
};

std::string nameOf(const std::shared_ptr<Image>& image) {
    const auto fake = std::dynamic_pointer_cast<test::FakeImage>(image);
    return fake ? fake->name : "none";
}

}  // namespace

class KTRDynVelaMapViewTest : public test::MapTest {};

// Creation

TEST_F(KTRDynVelaMapViewTest, Made_IsAMapThatNobodyMoves) {
    const auto map = makeMap();
    EXPECT_EQ(map->mapView()->superview(), map);
    EXPECT_EQ(map->mapView()->delegate(), KTRVAMapDelegate::sharedInstance());
    EXPECT_FALSE(map->mapView()->scrollEnabled());
    EXPECT_FALSE(map->mapView()->zoomEnabled());
    EXPECT_FALSE(map->mapView()->pitchEnabled());
    EXPECT_FALSE(map->mapView()->rotateEnabled());
    EXPECT_TRUE(map->mapView()->showsUserLocation());
    EXPECT_FALSE(map->translatesAutoresizingMaskIntoConstraints());
    EXPECT_NE(map->locationShifter(), nullptr);
    EXPECT_FALSE(map->isVisibilityMap());
    EXPECT_FALSE(map->isRegionSetOnMap());
    EXPECT_EQ(map->accessibilityRole(), AccessibilityRole::Link);
}

TEST_F(KTRDynVelaMapViewTest, WithoutMapOrShifter_EverythingIsStillAnswered) {
    const auto map = makeMap();
    map->setLocationShifter(nullptr);
    show(*map, ann());
    EXPECT_EQ(map->mapAnnotation()->coordinate(), kAnn);
    map->setMapView(nullptr);
    map->setMapAnnotation(nullptr);
    map->setLocation(nullptr);
    map->setGeoFence(nullptr);
    map->updateMapWithLocation(nullptr);
    map->runMapRegionAfterDelay();
    for (const bool isVisibility : {false, true}) {
        map->setIsVisibilityMap(isVisibility);
        EXPECT_NO_FATAL_FAILURE(map->accessibilityText());
    }
    EXPECT_EQ(map->urlForTouch(), Url("wayloc://friend/(null)"));
}

TEST_F(KTRDynVelaMapViewTest, Made_SettlesHowAllPinsLook) {
    KTAnnotationView::setLargeAnnotationBorderVisible(true);
    KTAnnotationView::setLayerMaskingEnabled(false);
    makeMap();
    EXPECT_FALSE(KTAnnotationView::isLargeAnnotationBorderVisible());
    EXPECT_TRUE(KTAnnotationView::isLayerMaskingEnabled());
}

TEST_F(KTRDynVelaMapViewTest, Map_FillsItsView) {
    const auto map = makeMap();
    map->layoutIfNeeded();
    EXPECT_EQ(map->mapView()->frame(), (Rect{0.0, 0.0, 376.0, 219.0}));
}

// Pins

TEST_F(KTRDynVelaMapViewTest, Friend_GetsAPinWithTheMonogram) {
    contacts->contacts = {contactWith("ann", "ann@example.org", "")};
    const auto map = makeMap();
    show(*map, ann());
    ASSERT_EQ(map->mapView()->annotations().size(), 1U);
    const auto pin = map->mapAnnotation();
    EXPECT_EQ(map->mapView()->annotations()[0], pin);
    EXPECT_EQ(pin->coordinate(), kAnn);
    EXPECT_EQ(pin->tintColor(), KTRVATheme::ktrOrangeColor());
    EXPECT_EQ(nameOf(pin->largeAnnotationIcon()), "monogram ann");
    EXPECT_EQ(pin->smallAnnotationIcon(), pin->largeAnnotationIcon());
    EXPECT_FALSE(pin->isFenceAnnotation());
    ASSERT_FALSE(monogramMakers->calls.empty());
    EXPECT_EQ(monogramMakers->calls[0]->diameter, 89.0);
    EXPECT_EQ(monogramMakers->calls[0]->tintsAsked, (std::vector<std::optional<Color>>{KTRVATheme::ktrOrangeColor()}));
}

TEST_F(KTRDynVelaMapViewTest, FriendByPhone_IsLookedUpByPhone) {
    contacts->contacts = {contactWith("bo", "", "+1 555 0100")};
    const auto map = makeMap();
    show(*map, placed(friendByPhone("Bo", "+1 555 0100"), 51.0, -1.0));
    EXPECT_EQ(nameOf(map->mapAnnotation()->largeAnnotationIcon()), "monogram bo");
}

TEST_F(KTRDynVelaMapViewTest, Photo_ReplacesTheBorderAndNotTheMonogram) {
    const auto plain = makeMap();
    show(*plain, ann());
    EXPECT_TRUE(plain->mapAnnotation()->isBorderEnabled());
    const auto contact = contactWith("ann", "ann@example.org", "");
    contact->thumbnailImageData = Bytes{'i', 'm', 'a', 'g', 'e'};
    contacts->contacts = {contact};
    const auto map = makeMap();
    show(*map, ann());
    EXPECT_FALSE(map->mapAnnotation()->isBorderEnabled());
    EXPECT_EQ(nameOf(map->mapAnnotation()->largeAnnotationIcon()), "monogram ann");
}

TEST_F(KTRDynVelaMapViewTest, Moved_TheSamePinGoesOn) {
    const auto map = makeMap();
    show(*map, ann());
    const auto pin = map->mapAnnotation();
    show(*map, placed(ann(), 51.5, -1.5));
    EXPECT_EQ(map->mapAnnotation(), pin);
    EXPECT_EQ(map->mapView()->annotations().size(), 1U);
    EXPECT_EQ(pin->coordinate(), (Coordinate{51.5, -1.5}));
    EXPECT_EQ(circlesOf(*map), (Circles{{{51.5, -1.5}, 10.0}}));
}

TEST_F(KTRDynVelaMapViewTest, Update_LeavesWhatIsNotItsOwn) {
    const auto map = makeMap();
    const auto other = std::make_shared<OtherPin>();
    map->mapView()->addAnnotation(other);
    const auto overlay = std::make_shared<OtherOverlay>();
    map->mapView()->addOverlay(overlay);
    show(*map, ann());
    EXPECT_EQ(map->mapView()->annotations().size(), 2U);
    EXPECT_EQ(map->mapView()->annotations()[0], other);
    ASSERT_EQ(map->mapView()->overlays().size(), 2U);
    EXPECT_EQ(map->mapView()->overlays()[0], overlay);
    EXPECT_EQ(circlesOf(*map), (Circles{{kAnn, 10.0}}));
}

TEST_F(KTRDynVelaMapViewTest, NoPosition_ComesFromTheShifterAsNullIsland_IsKept) {
    const auto map = makeMap();
    show(*map, friendByEmail("Ann", "ann@example.org"));
    ASSERT_EQ(map->mapView()->annotations().size(), 1U);
    EXPECT_EQ(map->mapAnnotation()->coordinate(), Coordinate{});
    EXPECT_FALSE(map->mapAnnotation()->hasKnownLocation()) << "its view draws nothing";
    EXPECT_EQ(circlesOf(*map), (Circles{{{}, 0.0}}));
    EXPECT_EQ(map->mapView()->requestedRegion(), std::nullopt);
}

TEST_F(KTRDynVelaMapViewTest, PlaceWithoutDegrees_HasNoPin) {
    const auto map = makeMap();
    map->updateMapWithLocation(ann());
    map->updateMapWithLocation(friendByEmail("Ann", "ann@example.org"));
    EXPECT_TRUE(map->mapView()->annotations().empty());
}

TEST_F(KTRDynVelaMapViewTest, HalfAPosition_NoPin) {
    auto object = ann();
    object->longitude = std::nullopt;
    const auto map = makeMap();
    map->updateMapWithLocation(object);
    EXPECT_TRUE(map->mapView()->annotations().empty());
}

TEST_F(KTRDynVelaMapViewTest, NullIsland_HasAPinAndACircleButNoRegion) {
    const auto map = makeMap();
    show(*map, placed(ann(), 0.0, 0.0));
    EXPECT_EQ(map->mapView()->annotations().size(), 1U);
    EXPECT_FALSE(map->mapAnnotation()->hasKnownLocation());
    EXPECT_EQ(circlesOf(*map), (Circles{{{}, 10.0}}));
    EXPECT_EQ(map->mapView()->requestedRegion(), std::nullopt);
}

TEST_F(KTRDynVelaMapViewTest, NoRecord_UpdatesWithNothing_IsKept) {
    const auto map = makeMap();
    const auto shifter = std::make_shared<PatientShifter>();
    map->setLocationShifter(shifter);
    map->setLocation(nullptr);
    EXPECT_EQ(shifter->asked, std::vector<Coordinate>{{}});
    shifter->completions[0]({5.0, 5.0});
    EXPECT_TRUE(map->mapView()->annotations().empty());
    EXPECT_EQ(circlesOf(*map), (Circles{{{}, 0.0}}));
}

TEST_F(KTRDynVelaMapViewTest, DelegateGone_ComesBackWithTheNextUpdate) {
    const auto map = makeMap();
    map->mapView()->setDelegate({});
    show(*map, ann());
    EXPECT_EQ(map->mapView()->delegate(), KTRVAMapDelegate::sharedInstance());
}

TEST_F(KTRDynVelaMapViewTest, NeitherFriendNorFence_PinIsAFencesAndStaysOne_IsKept) {
    const auto map = makeMap();
    const auto pin = map->mapAnnotation();
    EXPECT_TRUE(pin->isFenceAnnotation());
    show(*map, ann());
    EXPECT_EQ(map->mapAnnotation(), pin);
    EXPECT_TRUE(pin->isFenceAnnotation());
}

// Circles

TEST_F(KTRDynVelaMapViewTest, NoAccuracy_CircleOfRadiusZero) {
    const auto map = makeMap();
    auto object = ann();
    object->accuracy = std::nullopt;
    show(*map, object);
    EXPECT_EQ(circlesOf(*map), (Circles{{kAnn, 0.0}}));
}

TEST_F(KTRDynVelaMapViewTest, SameAgain_OneCircle) {
    const auto map = makeMap();
    show(*map, ann());
    show(*map, ann());
    EXPECT_EQ(circlesOf(*map), (Circles{{kAnn, 10.0}}));
}

TEST_F(KTRDynVelaMapViewTest, AtNullIsland_TheSameCircleStaysAndAnotherIsReplaced) {
    const auto map = makeMap();
    map->updateMapWithLocation(placed(ann(), 0.0, 0.0));
    const auto circle = map->mapView()->overlays()[0];
    map->updateMapWithLocation(placed(ann(), 0.0, 0.0));
    ASSERT_EQ(map->mapView()->overlays().size(), 1U);
    EXPECT_EQ(map->mapView()->overlays()[0], circle);
    auto surer = placed(ann(), 0.0, 0.0);
    surer->accuracy = 5.0;
    map->updateMapWithLocation(surer);
    EXPECT_EQ(circlesOf(*map), (Circles{{{}, 5.0}}));
}

TEST_F(KTRDynVelaMapViewTest, NowhereAgainAndAgain_CirclesOfNothingPileUp_IsKept) {
    const auto map = makeMap();
    map->updateMapWithLocation(nullptr);
    map->updateMapWithLocation(nullptr);
    EXPECT_EQ(circlesOf(*map), (Circles{{{}, 0.0}, {{}, 0.0}}));
    map->updateMapWithLocation(ann());
    EXPECT_EQ(circlesOf(*map), (Circles{{kAnn, 10.0}}));
}

TEST_F(KTRDynVelaMapViewTest, OverlaysWithoutACircle_GetOne) {
    const auto map = makeMap();
    map->mapView()->addOverlay(std::make_shared<OtherOverlay>());
    map->updateMapWithLocation(placed(ann(), 0.0, 0.0));
    EXPECT_EQ(circlesOf(*map), (Circles{{{}, 10.0}}));
}

// The map's datum

TEST_F(KTRDynVelaMapViewTest, ShiftedPlace_IsShownAndTheRecordStays) {
    const auto map = makeMap();
    const auto shifter = std::make_shared<PatientShifter>();
    map->setLocationShifter(shifter);
    const auto object = ann();
    map->setLocation(record(object));
    EXPECT_EQ(shifter->asked, std::vector<Coordinate>{kAnn});
    EXPECT_TRUE(map->mapView()->annotations().empty());
    shifter->completions[0]({52.0, -2.0});
    EXPECT_EQ(map->mapAnnotation()->coordinate(), (Coordinate{52.0, -2.0}));
    EXPECT_EQ(circlesOf(*map), (Circles{{{52.0, -2.0}, 10.0}}));
    EXPECT_EQ(object->latitude, 51.0);
    EXPECT_EQ(object->longitude, -1.0);
}

TEST_F(KTRDynVelaMapViewTest, LateAnswerToAnEarlierQuestion_IsIgnored) {
    const auto map = makeMap();
    const auto shifter = std::make_shared<PatientShifter>();
    map->setLocationShifter(shifter);
    map->setLocation(record(ann()));
    map->setLocation(record(placed(ann(), 53.0, -3.0)));
    shifter->completions[1]({53.0, -3.0});
    shifter->completions[0](kAnn);
    EXPECT_EQ(map->mapAnnotation()->coordinate(), (Coordinate{53.0, -3.0}));
}

TEST_F(KTRDynVelaMapViewTest, MapGone_TheShiftersAnswerDoesNothing) {
    auto map = makeMap();
    const auto shifter = std::make_shared<PatientShifter>();
    map->setLocationShifter(shifter);
    map->setLocation(record(ann()));
    const std::weak_ptr<View> gone = map;
    map.reset();
    EXPECT_TRUE(gone.expired());
    shifter->completions[0](kAnn);
}

// Taps

TEST_F(KTRDynVelaMapViewTest, Tap_OpensTheFriend) {
    const auto map = makeMap();
    map->setLocation(record(ann()));
    log->clear();
    EXPECT_EQ(map->urlForTouch(), Url("wayloc://friend/ann@example.org"));
    EXPECT_TRUE(
        log->has(LogLevel::Default, "Opening URL: wayloc://friend/ann@example.org for friend handle: ann@example.org"));
}

TEST_F(KTRDynVelaMapViewTest, Tap_OnAFence_OpensItsFriend) {
    const auto map = makeMap();
    map->setGeoFence(test::fenceOf(friendByEmail("Ann", "ann@example.org")->friend_, std::nullopt));
    EXPECT_EQ(map->urlForTouch(), Url("wayloc://friend/ann@example.org"));
}

TEST_F(KTRDynVelaMapViewTest, Tap_WithoutFriendOrFence_StillOpensAFriend_IsKept) {
    const auto url = makeMap()->urlForTouch();
    ASSERT_TRUE(url.has_value());
    EXPECT_EQ(url, Url("wayloc://friend/(null)"));
}

TEST_F(KTRDynVelaMapViewTest, OpenInMaps_OpensThePinsPlace) {
    const auto map = makeMap();
    map->setLocation(record(ann()));
    map->openInMaps();
    EXPECT_TRUE(log->has(LogLevel::Default, "openInMaps"));
    ASSERT_EQ(mapsApplication->opened.size(), 1U);
    EXPECT_EQ(mapsApplication->opened[0].coordinate, kAnn);
    EXPECT_EQ(mapsApplication->opened[0].name, "Ann");
}

}  // namespace ktr
