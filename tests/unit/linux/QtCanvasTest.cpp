#include "linux/paint/QtCanvas.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>

#include "linux/paint/QtImage.h"
#include "linux/paint/RasterImage.h"

namespace ktr::linux_ {

using platform::Color;

namespace {

class QtCanvasTest : public ::testing::TestWithParam<double> {
  protected:
    QtCanvasTest() {
        image_.fill(Qt::white);
        painter_.begin(&image_);
        painter_.setRenderHint(QPainter::Antialiasing);
        painter_.scale(GetParam(), GetParam());
    }
    ~QtCanvasTest() override { painter_.end(); }

    /// The rows of a column that are not white: none may be half painted.
    std::vector<int> paintedRows(int x = 3) {
        std::vector<int> rows;
        for (int y = 0; y < image_.height(); ++y) {
            const QRgb pixel = image_.pixel(x, y);
            EXPECT_TRUE(pixel == qRgb(255, 255, 255) || pixel == qRgb(0, 0, 0)) << "blurred row " << y;
            if (pixel != qRgb(255, 255, 255)) {
                rows.push_back(y);
            }
        }
        return rows;
    }

    /// Notes how it is drawn.
    struct Noting : QtImage {
        platform::Size size() const override { return {10.0, 10.0}; }
        void draw(QPainter& /*painter*/, const QRectF& /*rect*/, const Palette& /*palette*/) const override {
            ++stills;
        }
        void drawMoving(QPainter& /*painter*/, const QRectF& /*rect*/, const Palette& /*palette*/) const override {
            ++frames;
        }
        mutable int stills = 0;
        mutable int frames = 0;
    };

    QImage image_{60, 400, QImage::Format_ARGB32_Premultiplied};
    QPainter painter_;
    QtCanvas canvas_{painter_, Palette::of(ColorScheme::Light)};
};

const Color kBlack = Color::rgb(0, 0, 0);

}  // namespace

TEST_P(QtCanvasTest, Hairline_IsOnePixelWhereverItFalls) {
    for (const double pixels : {0.5, 1.0, 1.4}) {
        for (int i = 0; i < 97; ++i) {
            image_.fill(Qt::white);
            canvas_.fill({0, 10 + i * 0.173, 20, pixels / GetParam()}, kBlack);
            EXPECT_EQ(paintedRows().size(), 1U) << i;
        }
    }
}

TEST_P(QtCanvasTest, ThinnestRectangle_IsOnePixel) {
    canvas_.fill({0, 10.3, 20, 0.001}, kBlack);
    EXPECT_EQ(paintedRows().size(), 1U);
}

TEST_P(QtCanvasTest, NothingOrClear_PaintsNothing) {
    canvas_.fill({0, 10, 20, 0}, kBlack);
    canvas_.fill({0, 10, 0, 20}, kBlack);
    canvas_.fill({0, 10, 20, 20}, Color::clear());
    EXPECT_TRUE(paintedRows().empty());
}

TEST_P(QtCanvasTest, Neighbours_MeetWithoutGapOrOverlap) {
    for (int i = 0; i < 40; ++i) {
        const double y = 5 + i * 0.137;
        const double split = y + 20.31;
        const QRectF upper = canvas_.snapped({0, y, 20, split - y});
        const QRectF lower = canvas_.snapped({0, split, 20, 30.77});
        EXPECT_NEAR(upper.bottom(), lower.top(), 1e-9);
    }
}

TEST_P(QtCanvasTest, Fill_StandsOnWholePixels) {
    canvas_.translate(0.3, 7.37);
    canvas_.fill({0, 3.21, 20, 11.9}, kBlack);
    const auto rows = paintedRows();
    EXPECT_NEAR(static_cast<double>(rows.size()), 11.9 * GetParam(), 1.0);
}

TEST_P(QtCanvasTest, Clip_LimitsWhatIsPaintedUntilRestored) {
    canvas_.save();
    canvas_.clip({0, 10, 20, 10});
    canvas_.fill({0, 0, 20, 100}, kBlack);
    canvas_.restore();
    const auto clipped = paintedRows();
    EXPECT_EQ(static_cast<double>(clipped.size()), 10 * GetParam());
    canvas_.fill({0, 0, 20, 100}, kBlack);
    EXPECT_EQ(static_cast<double>(paintedRows().size()), 100 * GetParam());
}

TEST_P(QtCanvasTest, Pixel_IsADevicePixel) {
    EXPECT_DOUBLE_EQ(canvas_.pixel(), 1.0 / GetParam());
}

// A map that is zoomed has another size in each frame: scaling all of it for each took longer than a frame.
TEST_P(QtCanvasTest, MovingPicture_IsDrawnForThisFrameAlone) {
    const Noting image;
    canvas_.drawMoving(image, {0.0, 0.0, 20.0, 20.0});
    EXPECT_EQ(image.frames, 1);
    EXPECT_EQ(image.stills, 0);
}

TEST_P(QtCanvasTest, MovingPixels_FillTheirPlace) {
    QImage pixels(100, 100, QImage::Format_ARGB32_Premultiplied);
    pixels.fill(Qt::black);
    canvas_.drawMoving(RasterImage(pixels, {100.0, 100.0}), {0.0, 4.0, 20.0, 20.0});
    const auto rows = paintedRows();
    ASSERT_EQ(rows.size(), static_cast<std::size_t>(20.0 * GetParam()));
    EXPECT_EQ(rows.front(), static_cast<int>(4.0 * GetParam()));
}

INSTANTIATE_TEST_SUITE_P(Scales, QtCanvasTest, ::testing::Values(1.0, 1.5, 2.0, 3.0));

}  // namespace ktr::linux_
