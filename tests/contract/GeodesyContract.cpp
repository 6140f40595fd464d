#include "tests/contract/GeodesyContract.h"

#include <cmath>
#include <limits>

#include "tests/support/Doubles.h"

namespace ktr::test {

using platform::Coordinate;

TEST_P(GeodesyContract, TheSamePlace_IsNoDistanceAway) {
    EXPECT_EQ(geodesy->distance({54.5, -1.25}, {54.5, -1.25}), 0.0);
}

TEST_P(GeodesyContract, ADegreeAlongTheEquator) {
    // 111,319.5 m on the ellipsoid; a sphere comes within 0.6 %.
    EXPECT_NEAR(geodesy->distance({0.0, 10.0}, {0.0, 11.0}), 111319.5, 111319.5 * 0.006);
}

TEST_P(GeodesyContract, FromPoleToPole) {
    EXPECT_NEAR(geodesy->distance({90.0, 0.0}, {-90.0, 0.0}), 20003931.5, 20003931.5 * 0.006);
}

TEST_P(GeodesyContract, TheShortestWayCrossesTheDateLine) {
    EXPECT_NEAR(geodesy->distance({0.0, 179.5}, {0.0, -179.5}), 111319.5, 111319.5 * 0.006);
}

TEST_P(GeodesyContract, BothDirectionsAreOfOneLength) {
    const Coordinate a{54.52, -1.19};
    const Coordinate b{54.53, -1.21};
    EXPECT_DOUBLE_EQ(geodesy->distance(a, b), geodesy->distance(b, a));
}

TEST_P(GeodesyContract, InvalidCoordinates_GiveNaN) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double infinity = std::numeric_limits<double>::infinity();
    for (const Coordinate& bad : {Coordinate{90.1, 0.0}, Coordinate{0.0, -180.1}, Coordinate{nan, 0.0},
                                  Coordinate{0.0, nan}, Coordinate{infinity, 0.0}}) {
        EXPECT_TRUE(std::isnan(geodesy->distance(bad, {0.0, 0.0})));
        EXPECT_TRUE(std::isnan(geodesy->distance({0.0, 0.0}, bad)));
    }
}

INSTANTIATE_TEST_SUITE_P(SphereGeodesy, GeodesyContract,
                         ::testing::Values(GeodesyCase{"SphereGeodesy",
                                                       [] { return std::make_shared<SphereGeodesy>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
