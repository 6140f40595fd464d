#include "platform/map/LocationShifter.h"

#include <cmath>

#include "tests/support/PatientMaps.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using platform::Coordinate;
using platform::LocationShifter;

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
        const Coordinate shifted = LocationShifter::gcj02(point.wgs84);
        EXPECT_NEAR(shifted.latitude, point.gcj02.latitude, 1e-6);
        EXPECT_NEAR(shifted.longitude, point.gcj02.longitude, 1e-6);
    }
}

TEST_F(LocationShifterTest, InTheCountry_PlacesMoveBySomeHundredMetres) {
    for (const Coordinate& place : {Coordinate{43.82, 87.61}, Coordinate{45.80, 126.53}, Coordinate{29.65, 91.11},
                                    Coordinate{25.04, 102.71}, Coordinate{20.04, 110.34}, Coordinate{30.27, 120.15}}) {
        const double metres = geodesy->distance(place, LocationShifter::gcj02(place));
        EXPECT_GT(metres, 50.0);
        EXPECT_LT(metres, 1500.0);
    }
}

TEST_F(LocationShifterTest, TheMapsDecideWhatMoves) {
    const Coordinate beijing{39.911954, 116.377817};
    const Coordinate seoul{37.57, 126.98};
    EXPECT_EQ(asked(beijing), beijing);
    const auto maps = std::make_shared<PatientMaps>();
    platform->maps = maps;
    EXPECT_EQ(asked(beijing), beijing);
    maps->isShifted = [](const Coordinate& place) { return place.longitude < 120.0; };
    EXPECT_EQ(asked(beijing), LocationShifter::gcj02(beijing));
    EXPECT_NE(asked(beijing), beijing);
    EXPECT_EQ(asked(seoul), seoul);
}

TEST_F(LocationShifterTest, InvalidCoordinate_StaysAsItIs) {
    const auto maps = std::make_shared<PatientMaps>();
    platform->maps = maps;
    maps->isShifted = [](const Coordinate&) { return true; };
    const Coordinate bad{91.0, 116.0};
    EXPECT_EQ(asked(bad), bad);
    EXPECT_TRUE(std::isnan(asked({std::nan(""), 116.0}).latitude));
}

TEST_F(LocationShifterTest, NoLocation_ReadsAsNullIsland) {
    Coordinate answer{-1.0, -1.0};
    LocationShifter().shiftLocation(nullptr, [&](const Coordinate& shifted) { answer = shifted; });
    EXPECT_EQ(answer, Coordinate{});
}

}  // namespace ktr::test
