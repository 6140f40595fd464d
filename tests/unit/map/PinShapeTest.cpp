#include "platform/map/PinShape.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace ktr::test {

using platform::Path;
using platform::PinShape;

TEST(PinShapeTest, FriendPin_LeavesItsCircleAndRunsToTheTip) {
    const Path path = PinShape{34.75, 10.0, 25.0}.outline();
    const auto& elements = path.elements();
    EXPECT_NEAR(elements.front().end.x, -14.69, 0.005);
    EXPECT_NEAR(elements.front().end.y, -13.26, 0.005);
    const auto& toTip = elements[elements.size() - 3];
    EXPECT_EQ(toTip.verb, Path::Verb::Quad);
    EXPECT_NEAR(toTip.control1.x, 6.08, 0.005);
    EXPECT_NEAR(toTip.control1.y, -9.24, 0.005);
    EXPECT_EQ(toTip.end, (platform::Point{0.0, 0.0}));
}

TEST(PinShapeTest, Marker) {
    const Path path = PinShape{20.75, 8.0, 27.0}.outline();
    EXPECT_NEAR(path.elements().front().end.x, -9.42, 0.005);
    EXPECT_NEAR(path.elements().front().end.y, -10.26, 0.005);
    const auto& toTip = path.elements()[path.elements().size() - 3];
    EXPECT_NEAR(toTip.control1.x, 2.65, 0.005);
    EXPECT_NEAR(toTip.control1.y, -6.81, 0.005);
}

TEST(PinShapeTest, Extent_HoldsTheOutline) {
    const PinShape pin{34.75, 10.0, 25.0};
    const auto extent = pin.extent();
    double top = 0.0;
    const auto expectInside = [&](const platform::Point& point) {
        EXPECT_GE(point.x, extent.x);
        EXPECT_LE(point.x, extent.maxX());
        EXPECT_GE(point.y, extent.y);
        EXPECT_LE(point.y, extent.maxY());
        top = std::min(top, point.y);
    };
    platform::Point from;
    const Path path = pin.outline();
    for (const Path::Element& element : path.elements()) {
        for (double t = 0.0; t <= 1.0 && element.verb == Path::Verb::Cubic; t += 0.02) {
            const double u = 1.0 - t;
            const auto along = [&](double a, double b, double c, double d) {
                return u * u * u * a + 3.0 * u * u * t * b + 3.0 * u * t * t * c + t * t * t * d;
            };
            expectInside({along(from.x, element.control1.x, element.control2.x, element.end.x),
                          along(from.y, element.control1.y, element.control2.y, element.end.y)});
        }
        from = element.end;
        expectInside(from);
    }
    EXPECT_NEAR(top, -79.5, 0.02);
}

}  // namespace ktr::test
