#include "linux/paint/QtTextImage.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <algorithm>
#include <cstdlib>
#include <thread>

#include "linux/paint/QtCanvas.h"
#include "linux/paint/QtTextEngine.h"
#include "platform/base/VirtualTime.h"
#include "tests/support/PlatformTest.h"

namespace ktr::linux_ {

using platform::AttributedString;
using platform::Font;
using platform::TextImage;

namespace {

constexpr double kWidth = 200.0;

}  // namespace

class QtTextImageTest : public test::PlatformTest {
  protected:
    QtTextImageTest() {
        platform::TextContainer container;
        container.width = kWidth;
        const AttributedString text("Ann Marsh\nFish Market, ليلى, अनन्या", Font{.size = 30.0});
        layout_ = engine_.layOut(text, container);
        size_ = {kWidth, layout_->usedSize().height};
    }
    std::shared_ptr<TextImage> made(double scale) { return engine_.image(layout_, size_, scale); }
    /// The picture on a ground, painted at a scale and at a place that is no whole pixel.
    static QImage painted(const platform::Image& image, double scale, const Palette& palette) {
        QImage ground(static_cast<int>(260 * scale), static_cast<int>(200 * scale), QImage::Format_RGB32);
        ground.fill(palette.card);
        QPainter painter(&ground);
        painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing);
        painter.scale(scale, scale);
        QtCanvas(painter, palette).draw(image, {10.3, 15.4, 240.0, 40.0});
        painter.end();
        return ground;
    }
    static int largestDifference(const QImage& a, const QImage& b) {
        int largest = a.size() == b.size() ? 0 : 1000;
        for (int y = 0; y < a.height() && largest < 1000; ++y) {
            for (int x = 0; x < a.width(); ++x) {
                largest = std::max(largest, std::abs(qGray(a.pixel(x, y)) - qGray(b.pixel(x, y))));
            }
        }
        return largest;
    }
    static bool isBlank(const QImage& image) {
        QImage blank = image;
        blank.fill(image.pixel(0, 0));
        return blank == image;
    }

    const Palette& light_ = Palette::of(ColorScheme::Light);
    const Palette& dark_ = Palette::of(ColorScheme::Dark);
    QtTextEngine engine_;
    std::shared_ptr<const platform::TextLayout> layout_;
    platform::Size size_;
};

TEST_F(QtTextImageTest, Pixels_LookAsTheTextItselfDoes) {
    const TextImage text(layout_, size_);
    for (const double scale : {1.0, 1.5, 2.0}) {
        const QImage pixels = painted(*made(scale), scale, light_);
        EXPECT_FALSE(isBlank(pixels));
        EXPECT_LE(largestDifference(pixels, painted(text, scale, light_)), 3) << scale;
        EXPECT_EQ(time->pendingTimers(), 0u);
    }
}

TEST_F(QtTextImageTest, AnotherScale_IsDrawnFromTheTextAtOnce) {
    const TextImage text(layout_, size_);
    EXPECT_EQ(largestDifference(painted(*made(1.0), 2.0, light_), painted(text, 2.0, light_)), 0);
}

TEST_F(QtTextImageTest, OtherColours_AreDrawnFromTheTextUntilTheirPixelsAreThere) {
    const TextImage text(layout_, size_);
    const auto image = made(2.0);
    const QImage drawn = painted(*image, 2.0, dark_);
    EXPECT_EQ(largestDifference(drawn, painted(text, 2.0, dark_)), 0);
    time->runPosted();
    const int before = static_cast<int>(engine_.shapedCount());
    const QImage pixels = painted(*image, 2.0, dark_);
    EXPECT_LE(largestDifference(pixels, drawn), 3);
    EXPECT_EQ(static_cast<int>(engine_.shapedCount()), before);
    // What is made from now on has these colours from the start.
    EXPECT_LE(largestDifference(painted(*made(2.0), 2.0, dark_), drawn), 3);
}

TEST_F(QtTextImageTest, MadeOnAnotherThread_IsThePictureOfThisOne) {
    std::shared_ptr<TextImage> image;
    std::thread([&] {
        platform::TextContainer container;
        container.width = kWidth;
        image = engine_.image(
            engine_.layOut(AttributedString("Ann Marsh\nFish Market, ليلى, अनन्या", Font{.size = 30.0}), container),
            size_, 2.0);
    }).join();
    EXPECT_LE(largestDifference(painted(*image, 2.0, light_), painted(*made(2.0), 2.0, light_)), 1);
}

TEST_F(QtTextImageTest, ImageThatIsDropped_LeavesNothingBehind) {
    auto image = made(1.0);
    painted(*image, 2.0, dark_);
    const std::weak_ptr<TextImage> gone = image;
    image = nullptr;
    EXPECT_TRUE(gone.expired());
    time->runPosted();
}

TEST_F(QtTextImageTest, PictureOfTooManyPixels_IsDrawnFromTheText) {
    const platform::Size huge = {30000.0, 30000.0};
    const auto image = engine_.image(layout_, huge, 2.0);
    EXPECT_EQ(image->size(), huge);
    const TextImage text(layout_, huge);
    EXPECT_EQ(largestDifference(painted(*image, 2.0, light_), painted(text, 2.0, light_)), 0);
}

}  // namespace ktr::linux_
