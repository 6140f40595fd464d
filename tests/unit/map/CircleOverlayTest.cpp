#include "platform/map/CircleOverlay.h"

#include <limits>

#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"

namespace ktr::test {

using platform::CircleOverlay;
using platform::CircleOverlayRenderer;
using platform::MapViewport;
using platform::Rect;

class CircleOverlayTest : public PlatformTest {
  protected:
    RecordingCanvas drawn(const platform::Coordinate& center, double radius) {
        CircleOverlayRenderer renderer(std::make_shared<CircleOverlay>(center, radius));
        renderer.setFillColor(platform::Color::rgb(0.5, 0.25, 0.0));
        renderer.setAlpha(0.2);
        RecordingCanvas canvas;
        renderer.draw(canvas, view_);
        return canvas;
    }

    MapViewport view_{{50.21, -3.12}, 15.0, {376.0, 219.0}};
};

TEST_F(CircleOverlayTest, StandsOnItsPlaceWithItsRadius) {
    const Rect rect = CircleOverlayRenderer::rectFor({50.21, -3.12}, 100.0, view_);
    const double points = 100.0 / view_.metresPerPoint();
    EXPECT_NEAR(rect.x + rect.width / 2.0, 188.0, 0.01);
    EXPECT_NEAR(rect.y + rect.height / 2.0, 109.5, 0.01);
    EXPECT_NEAR(rect.width / 2.0, points, 0.005 * points);
    EXPECT_NEAR(rect.height / 2.0, points, 0.005 * points);
}

TEST_F(CircleOverlayTest, IsFilledWithItsAlphaAndNotStroked) {
    const auto canvas = drawn({50.21, -3.12}, 100.0);
    ASSERT_EQ(canvas.calls.size(), 1u);
    EXPECT_EQ(canvas.calls[0].kind, RecordingCanvas::Call::Kind::Path);
    EXPECT_DOUBLE_EQ(canvas.calls[0].color.alpha, 0.2);
}

TEST_F(CircleOverlayTest, ZeroAndNegativeRadius_DrawNothing) {
    EXPECT_TRUE(drawn({50.21, -3.12}, 0.0).calls.empty());
    EXPECT_TRUE(drawn({50.21, -3.12}, -5.0).calls.empty());
    EXPECT_TRUE(drawn({50.21, -3.12}, std::numeric_limits<double>::infinity()).calls.empty());
    EXPECT_TRUE(drawn({150.0, -3.12}, 10.0).calls.empty());
}

TEST_F(CircleOverlayTest, FarAway_DrawsNothing) {
    EXPECT_TRUE(drawn({10.0, 100.0}, 100.0).calls.empty());
}

TEST_F(CircleOverlayTest, LargerThanTheView_CoversIt) {
    const Rect rect = CircleOverlayRenderer::rectFor({50.21, -3.12}, 2e7, view_);
    EXPECT_LT(rect.x, -188.0);
    EXPECT_GT(rect.maxY(), 400.0);
}

TEST_F(CircleOverlayTest, NothingIsFilledUntilTold) {
    CircleOverlayRenderer renderer(std::make_shared<CircleOverlay>(platform::Coordinate{50.21, -3.12}, 50.0));
    RecordingCanvas canvas;
    renderer.draw(canvas, view_);
    EXPECT_TRUE(canvas.calls.empty());
    renderer.setStrokeColor(platform::Color::white(0.0, 1.0));
    renderer.draw(canvas, view_);
    ASSERT_EQ(canvas.calls.size(), 1u);
    EXPECT_EQ(canvas.calls[0].kind, RecordingCanvas::Call::Kind::Stroke);
}

}  // namespace ktr::test
