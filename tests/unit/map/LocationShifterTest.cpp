#include "platform/map/LocationShifter.h"

#include <cmath>

#include "tests/support/PatientMaps.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using platform::Coordinate;
using platform::LocationShifter;
using platform::MapDatum;

class LocationShifterTest : public PlatformTest {
  protected:
    Coordinate asked(const Coordinate& place) {
        Coordinate answer{-1.0, -1.0};
        LocationShifter().shiftLocation(position(place.latitude, place.longitude),
                                        [&](const Coordinate& shifted) { answer = shifted; });
        return answer;
    }
};

TEST_F(LocationShifterTest, PublishedReferencePoints) {
    struct Point {
        Coordinate wgs84;
        Coordinate gcj02;
    };
    // Shanghai, Shenzhen and Beijing, as the common test tables of the conversion have them.
    for (const Point& point : {Point{{31.1774276, 121.5272106}, {31.17530398364597, 121.531541859215}},
                               Point{{22.543847, 113.912316}, {22.540796131694766, 113.9171764808363}},
                               Point{{39.911954, 116.377817}, {39.91334545536069, 116.38404722455657}}}) {
        const Coordinate shifted = LocationShifter::shifted(point.wgs84, MapDatum::Gcj02);
        EXPECT_NEAR(shifted.latitude, point.gcj02.latitude, 1e-6);
        EXPECT_NEAR(shifted.longitude, point.gcj02.longitude, 1e-6);
    }
}

TEST_F(LocationShifterTest, InsideTheArea_PlacesMoveBySomeHundredMetres) {
    for (const Coordinate& place : {Coordinate{43.82, 87.61}, Coordinate{45.80, 126.53}, Coordinate{29.65, 91.11},
                                    Coordinate{25.04, 102.71}, Coordinate{20.04, 110.34}, Coordinate{30.27, 120.15}}) {
        const double metres = geodesy->distance(place, LocationShifter::shifted(place, MapDatum::Gcj02));
        EXPECT_GT(metres, 50.0);
        EXPECT_LT(metres, 1500.0);
    }
}

TEST_F(LocationShifterTest, OutsideTheArea_NothingMoves) {
    for (const Coordinate& place :
         {Coordinate{37.57, 126.98}, Coordinate{35.68, 139.69}, Coordinate{25.03, 121.56}, Coordinate{21.03, 105.85},
          Coordinate{47.92, 106.92}, Coordinate{27.72, 85.32}, Coordinate{43.12, 131.89}, Coordinate{43.24, 76.89},
          Coordinate{50.21, -3.12}, Coordinate{0.0, 0.0}, Coordinate{-89.0, 179.0}}) {
        EXPECT_EQ(LocationShifter::shifted(place, MapDatum::Gcj02), place);
    }
}

TEST_F(LocationShifterTest, InvalidCoordinate_StaysAsItIs) {
    const Coordinate bad{91.0, 116.0};
    EXPECT_EQ(LocationShifter::shifted(bad, MapDatum::Gcj02), bad);
    EXPECT_TRUE(std::isnan(LocationShifter::shifted({std::nan(""), 116.0}, MapDatum::Gcj02).latitude));
}

TEST_F(LocationShifterTest, TheMapsDatumDecides) {
    const Coordinate beijing{39.911954, 116.377817};
    EXPECT_EQ(asked(beijing), beijing);
    const auto maps = std::make_shared<PatientMaps>();
    platform->maps = maps;
    EXPECT_EQ(asked(beijing), beijing);
    maps->mapDatum = MapDatum::Gcj02;
    EXPECT_NE(asked(beijing), beijing);
}

TEST_F(LocationShifterTest, NoLocation_ReadsAsNullIsland) {
    Coordinate answer{-1.0, -1.0};
    LocationShifter().shiftLocation(nullptr, [&](const Coordinate& shifted) { answer = shifted; });
    EXPECT_EQ(answer, Coordinate{});
}

}  // namespace ktr::test
