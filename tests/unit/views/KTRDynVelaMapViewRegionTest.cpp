#include "tests/support/MapTest.h"

// Which part of the world a snippet's map shows.

namespace ktr {

using namespace platform;
using test::fenceOf;
using test::friendByEmail;
using test::placed;

namespace {

constexpr double kMetresOfADegree = 6371008.8 * 3.14159265358979 / 180.0;
constexpr Coordinate kAnn{51.0, -1.0};

}  // namespace

class KTRDynVelaMapViewRegionTest : public test::MapTest {
  protected:
    /// So many metres to the north of Ann.
    static std::shared_ptr<PlatformLocation> northOfAnn(double metres) {
        return position(51.0 + metres / kMetresOfADegree, -1.0);
    }
    static std::optional<MapRegion> regionOf(const KTRDynVelaMapView& map) { return map.mapView()->requestedRegion(); }
    static void expectSpan(const std::optional<MapRegion>& asked, const Coordinate& center, double metres) {
        ASSERT_TRUE(asked.has_value());
        EXPECT_EQ(asked->center, center);
        EXPECT_EQ(asked->span, MapRegion::around(center, metres, metres).span);
        EXPECT_NEAR(asked->span.latitudeDelta * kMetresOfADegree, metres, 0.01);
    }
    void tellPosition() {
        platform->notificationCenter->post({kCurrentLocationUpdatedNotification, nullptr});
        time->runPosted();
    }
    std::shared_ptr<KTRDynVelaMapView> mapOfAnn() {
        auto map = makeMap();
        show(*map, ann());
        return map;
    }
    std::shared_ptr<VAKtrGeoFence> fence(std::optional<double> radius) {
        auto made = fenceOf(friendByEmail("Ann", "ann@example.org")->friend_, std::nullopt);
        made->location->accuracy = radius;
        return made;
    }
};

// A friend

TEST_F(KTRDynVelaMapViewRegionTest, UserAt100Metres_AccuracyOf10_Is125MetresAroundTheFriend) {
    user->position = northOfAnn(100.0);
    const auto map = makeMap();
    show(*map, ann());
    ASSERT_TRUE(regionOf(*map).has_value());
    EXPECT_EQ(regionOf(*map)->center, kAnn);
    EXPECT_NEAR(regionOf(*map)->span.latitudeDelta * kMetresOfADegree, 125.0, 1e-3);
    EXPECT_LT(regionOf(*map)->span.latitudeDelta, 0.05);
}

TEST_F(KTRDynVelaMapViewRegionTest, UserAt500Kilometres_IsTheZoomLevel) {
    user->position = northOfAnn(500000.0);
    const auto map = makeMap();
    show(*map, ann());
    EXPECT_EQ(regionOf(*map), (MapRegion{kAnn, {0.05, 0.05}}));
}

TEST_F(KTRDynVelaMapViewRegionTest, UserUnknown_IsTheZoomLevel) {
    EXPECT_EQ(regionOf(*mapOfAnn()), (MapRegion{kAnn, {0.05, 0.05}}));
}

TEST_F(KTRDynVelaMapViewRegionTest, UserUnknown_CoarseAccuracy_IsTwoAndAHalfTimesIt) {
    auto object = ann();
    object->accuracy = 4000.0;
    const auto map = makeMap();
    show(*map, object);
    expectSpan(regionOf(*map), kAnn, 10000.0);
}

TEST_F(KTRDynVelaMapViewRegionTest, UserFar_CoarseAccuracy_LeavesTheUserOut) {
    user->position = northOfAnn(500000.0);
    auto object = ann();
    object->accuracy = 4000.0;
    const auto map = makeMap();
    show(*map, object);
    expectSpan(regionOf(*map), kAnn, 10000.0);
}

TEST_F(KTRDynVelaMapViewRegionTest, TheUsersRegion_CountsUpToTheZoomLevelItself) {
    user->position = northOfAnn(975.0);
    const auto map = makeMap();
    const double distance = user->position->distanceFromLocation(*position(51.0, -1.0)) + 25.0;
    const double exact = MapRegion::around(kAnn, distance, distance).span.latitudeDelta;
    map->setZoomLevel(exact);
    show(*map, ann());
    EXPECT_EQ(regionOf(*map)->span.latitudeDelta, exact);
    EXPECT_NE(regionOf(*map)->span.longitudeDelta, exact);
    const auto narrow = makeMap();
    narrow->setZoomLevel(exact * 0.999999);
    show(*narrow, ann());
    EXPECT_EQ(regionOf(*narrow), (MapRegion{kAnn, {exact * 0.999999, exact * 0.999999}}));
}

TEST_F(KTRDynVelaMapViewRegionTest, Accuracy_IsReadInSinglePrecision) {
    auto object = ann();
    object->accuracy = 4000.1;
    const auto map = makeMap();
    show(*map, object);
    const double read = static_cast<double>(4000.1F) * 2.5;
    ASSERT_NE(read, 4000.1 * 2.5);
    EXPECT_EQ(regionOf(*map)->span, MapRegion::around(kAnn, read, read).span);
    EXPECT_EQ(circlesOf(*map)[0].second, 4000.1);
}

TEST_F(KTRDynVelaMapViewRegionTest, NoZoomLevel_IsTheAccuracyAlone) {
    user->position = northOfAnn(100.0);
    const auto map = makeMap();
    map->setZoomLevel(0.0);
    show(*map, ann());
    expectSpan(regionOf(*map), kAnn, 25.0);
}

TEST_F(KTRDynVelaMapViewRegionTest, AtThePolesTheAntimeridianAndTheEquator_TheFriendIsInTheMiddle) {
    for (const Coordinate& place : {Coordinate{89.9, 10.0}, Coordinate{-89.9, 10.0}, Coordinate{12.0, 179.9999},
                                    Coordinate{12.0, -179.9999}, Coordinate{1e-7, 100.0}}) {
        user->position = position(place.latitude, place.longitude > 0.0 ? place.longitude - 0.01 : -179.98);
        const auto map = makeMap();
        show(*map, placed(ann(), place.latitude, place.longitude));
        ASSERT_TRUE(regionOf(*map).has_value());
        EXPECT_EQ(regionOf(*map)->center, place);
        EXPECT_LE(regionOf(*map)->span.latitudeDelta, 0.05);
        EXPECT_LE(regionOf(*map)->span.longitudeDelta, 360.0);
        const auto view = map->mapView()->viewportAtRest();
        const Point point = view.pointFor(place);
        EXPECT_GE(point.x, 0.0);
        EXPECT_LE(point.x, 376.0);
        EXPECT_GE(point.y, -1e-6);
        EXPECT_LE(point.y, 219.0 + 1e-6);
    }
}

TEST_F(KTRDynVelaMapViewRegionTest, AcrossTheAntimeridian_NeighboursAreNear) {
    user->position = position(12.0, 179.9995);
    const auto map = makeMap();
    show(*map, placed(ann(), 12.0, -179.9995));
    const double apart = 0.001 * kMetresOfADegree * 0.9781476;
    expectSpan(regionOf(*map), {12.0, -179.9995},
               user->position->distanceFromLocation(*position(12.0, -179.9995)) + 25.0);
    EXPECT_NEAR(user->position->distanceFromLocation(*position(12.0, -179.9995)), apart, 0.1);
}

TEST_F(KTRDynVelaMapViewRegionTest, OnTheEquatorOrPrimeMeridian_NoRegionOfItsOwn_IsKept) {
    for (const Coordinate& place : {Coordinate{0.0, 10.0}, Coordinate{10.0, 0.0}}) {
        const auto map = makeMap();
        show(*map, placed(ann(), place.latitude, place.longitude));
        EXPECT_EQ(regionOf(*map), std::nullopt);
        // The next position sets one: only 0, 0 is nowhere by then.
        tellPosition();
        EXPECT_EQ(regionOf(*map), (MapRegion{place, {0.05, 0.05}}));
    }
}

TEST_F(KTRDynVelaMapViewRegionTest, LostFriend_TheMapStaysWhereItIs) {
    const auto map = mapOfAnn();
    const auto before = regionOf(*map);
    show(*map, placed(ann(), 0.0, 0.0));
    tellPosition();
    EXPECT_EQ(regionOf(*map), before);
}

TEST_F(KTRDynVelaMapViewRegionTest, Region_IsSetOnTheNextTurn) {
    const auto map = makeMap();
    map->setLocation(record(ann()));
    EXPECT_EQ(regionOf(*map), std::nullopt);
    EXPECT_FALSE(map->isRegionSetOnMap());
    time->advance(0.0);
    EXPECT_NE(regionOf(*map), std::nullopt);
    EXPECT_TRUE(map->isRegionSetOnMap());
}

TEST_F(KTRDynVelaMapViewRegionTest, FirstRegion_IsThereAtOnce_LaterOnesAreGlidedTo) {
    const auto map = mapOfAnn();
    map->layoutIfNeeded();
    EXPECT_NEAR(map->mapView()->viewport().pointFor(kAnn).x, 188.0, 1e-6);
    show(*map, placed(ann(), 51.001, -1.0));
    const Coordinate moved{51.001, -1.0};
    EXPECT_GT(109.5 - map->mapView()->viewport().pointFor(moved).y, 0.5) << "still under way";
    time->advance(0.25);
    const double halfway = map->mapView()->viewport().pointFor(moved).y;
    EXPECT_LT(halfway, 109.5);
    time->advance(0.5);
    EXPECT_NEAR(map->mapView()->viewport().pointFor(moved).y, 109.5, 1e-6);
}

TEST_F(KTRDynVelaMapViewRegionTest, ReducedMotion_NothingGlides) {
    appearance->reducedMotion = true;
    const auto map = mapOfAnn();
    show(*map, placed(ann(), 51.001, -1.0));
    EXPECT_NEAR(map->mapView()->viewport().pointFor({51.001, -1.0}).y, 109.5, 1e-6);
}

TEST_F(KTRDynVelaMapViewRegionTest, NewPosition_ChoosesAnew) {
    const auto map = mapOfAnn();
    user->position = northOfAnn(100.0);
    tellPosition();
    EXPECT_NEAR(regionOf(*map)->span.latitudeDelta * kMetresOfADegree, 125.0, 1e-3);
}

TEST_F(KTRDynVelaMapViewRegionTest, NewPosition_MapOfNobody_SetsNothing) {
    const auto map = makeMap();
    user->position = northOfAnn(100.0);
    tellPosition();
    EXPECT_EQ(regionOf(*map), std::nullopt);
    EXPECT_FALSE(map->isRegionSetOnMap());
}

TEST_F(KTRDynVelaMapViewRegionTest, MapGone_NewPositionsAreNotHeard) {
    auto map = mapOfAnn();
    show(*map, placed(ann(), 51.001, -1.0));
    const std::weak_ptr<View> gone = map;
    map.reset();
    time->runUntilIdle(2.0);
    EXPECT_TRUE(gone.expired());
    tellPosition();
}

// The user

TEST_F(KTRDynVelaMapViewRegionTest, VisibilityMap_IsCloseAroundTheUser) {
    locationManagers->cached = position(50.2, -3.1);
    const auto map = makeMap();
    map->setIsVisibilityMap(true);
    map->updateMapWithLocation(ann());
    EXPECT_EQ(regionOf(*map), (MapRegion{{50.2, -3.1}, {0.0008, 0.0008}}));
    EXPECT_TRUE(map->mapView()->annotations().empty());
    EXPECT_TRUE(map->mapView()->overlays().empty());
}

TEST_F(KTRDynVelaMapViewRegionTest, VisibilityMap_UserUnknown_SetsNothing) {
    const auto map = makeMap();
    map->setIsVisibilityMap(true);
    map->updateMapWithLocation(nullptr);
    tellPosition();
    EXPECT_EQ(regionOf(*map), std::nullopt);
    EXPECT_FALSE(map->isRegionSetOnMap());
}

// A fence

TEST_F(KTRDynVelaMapViewRegionTest, LargeFence_IsShownWhole_WithoutTheFactor) {
    const auto map = makeMap();
    map->setZoomLevel(0.0008);
    map->setGeoFence(fence(5000.0));
    expectSpan(regionOf(*map), kAnn, 5000.0);
}

TEST_F(KTRDynVelaMapViewRegionTest, SmallFence_IsTheZoomLevel) {
    const auto map = makeMap();
    map->setZoomLevel(0.0008);
    map->setGeoFence(fence(50.0));
    EXPECT_EQ(regionOf(*map), (MapRegion{kAnn, {0.0008, 0.0008}}));
    map->setGeoFence(fence(std::nullopt));
    EXPECT_EQ(regionOf(*map), (MapRegion{kAnn, {0.0008, 0.0008}}));
}

TEST_F(KTRDynVelaMapViewRegionTest, Fence_ReplacesEverythingOnTheMap) {
    const auto map = makeMap();
    map->mapView()->addOverlay(std::make_shared<CircleOverlay>(Coordinate{1.0, 1.0}, 1.0));
    map->setGeoFence(fence(200.0));
    map->setGeoFence(fence(300.0));
    ASSERT_EQ(map->mapView()->annotations().size(), 1U);
    EXPECT_EQ(map->mapView()->annotations()[0], map->mapAnnotation());
    EXPECT_TRUE(map->mapAnnotation()->isFenceAnnotation());
    EXPECT_EQ(circlesOf(*map), (std::vector<std::pair<Coordinate, double>>{{kAnn, 300.0}}));
}

TEST_F(KTRDynVelaMapViewRegionTest, Fence_IsNeverGlidedTo) {
    const auto map = makeMap();
    map->setGeoFence(fence(200.0));
    map->layoutIfNeeded();
    const auto moved = fence(200.0);
    moved->location->latitude = 51.01;
    map->setGeoFence(moved);
    EXPECT_NEAR(map->mapView()->viewport().pointFor({51.01, -1.0}).y, 109.5, 1e-6);
    EXPECT_FALSE(map->isRegionSetOnMap());
}

TEST_F(KTRDynVelaMapViewRegionTest, Fence_PlaceIsNotShifted) {
    const auto map = makeMap();
    const auto shifter = std::make_shared<test::PatientShifter>();
    map->setLocationShifter(shifter);
    map->setGeoFence(fence(200.0));
    EXPECT_TRUE(shifter->asked.empty());
    EXPECT_EQ(map->mapAnnotation()->coordinate(), kAnn);
}

TEST_F(KTRDynVelaMapViewRegionTest, Fence_NewPosition_SetsNothing) {
    const auto map = makeMap();
    map->setGeoFence(fence(200.0));
    const auto before = regionOf(*map);
    map->setZoomLevel(0.1);
    user->position = northOfAnn(10.0);
    tellPosition();
    EXPECT_EQ(regionOf(*map), before);
}

}  // namespace ktr
