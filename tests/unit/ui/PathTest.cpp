#include "platform/ui/Path.h"

#include <gtest/gtest.h>

#include <cmath>

namespace ktr::test {

using platform::Path;
using platform::Rect;

TEST(PathTest, Circle_FillsItsSquare) {
    Path path;
    path.addCircle({10.0, 20.0}, 5.0);
    const Rect bounds = path.controlBounds();
    EXPECT_NEAR(bounds.x, 5.0, 1e-9);
    EXPECT_NEAR(bounds.y, 15.0, 1e-9);
    EXPECT_NEAR(bounds.width, 10.0, 1e-9);
    EXPECT_NEAR(bounds.height, 10.0, 1e-9);
    EXPECT_EQ(path.elements().back().verb, Path::Verb::Close);
}

TEST(PathTest, Arc_RunsClockwiseOnTheScreen) {
    Path path;
    path.addArc({0.0, 0.0}, 10.0, 0.0, 90.0);
    EXPECT_EQ(path.elements().front().verb, Path::Verb::Move);
    EXPECT_NEAR(path.elements().back().end.x, 0.0, 1e-9);
    EXPECT_NEAR(path.elements().back().end.y, 10.0, 1e-9);
    Path back;
    back.addArc({0.0, 0.0}, 10.0, 0.0, -90.0);
    EXPECT_NEAR(back.elements().back().end.y, -10.0, 1e-9);
}

TEST(PathTest, Arc_ContinuesWhatIsUnderWay) {
    Path path;
    path.moveTo({-20.0, 0.0});
    path.addArc({0.0, 0.0}, 10.0, 180.0, 180.0);
    EXPECT_EQ(path.elements()[1].verb, Path::Verb::Line);
    EXPECT_NEAR(path.elements()[1].end.x, -10.0, 1e-9);
}

TEST(PathTest, RoundedRect_StaysInside) {
    Path path;
    path.addRoundedRect({1.0, 2.0, 30.0, 10.0}, 99.0);
    const Rect bounds = path.controlBounds();
    EXPECT_NEAR(bounds.x, 1.0, 1e-9);
    EXPECT_NEAR(bounds.maxX(), 31.0, 1e-9);
    EXPECT_NEAR(bounds.height, 10.0, 1e-9);
}

TEST(PathTest, Translated_MovesEverything) {
    Path path;
    path.moveTo({0.0, 0.0});
    path.cubicTo({1.0, 0.0}, {2.0, 1.0}, {3.0, 3.0});
    const Path moved = path.translated(10.0, -1.0);
    EXPECT_EQ(moved.elements()[1].control1, (platform::Point{11.0, -1.0}));
    EXPECT_EQ(moved.elements()[1].end, (platform::Point{13.0, 2.0}));
}

TEST(PathTest, Empty_HasNoExtent) {
    EXPECT_TRUE(Path().empty());
    EXPECT_EQ(Path().controlBounds(), Rect{});
}

}  // namespace ktr::test
