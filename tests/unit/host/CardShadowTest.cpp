#include "host/conversation/CardShadow.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <algorithm>
#include <cstdlib>

#include "host/conversation/Shapes.h"
#include "linux/paint/Palette.h"

namespace ktr::host {
namespace {

constexpr double kCorner = 20.0;  // points

const linux_::Palette& palette() {
    static const linux_::Palette light = linux_::Palette::of(linux_::ColorScheme::Light);
    return light;
}

/// The shadow under a card, or the part of it that the card leaves to be seen, and the card.
QImage painted(bool isAround, const QRectF& card, double scale, double opacity, bool hasCard = true) {
    QImage image(static_cast<int>(460 * scale), static_cast<int>(1100 * scale), QImage::Format_ARGB32_Premultiplied);
    image.fill(hasCard ? palette().window : QColor(Qt::transparent));
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(scale, scale);
    painter.setOpacity(opacity);
    linux_::QtCanvas canvas(painter, palette());
    CardShadow shadow;
    if (isAround) {
        shadow.paintAround(canvas, card, kCorner);
    } else {
        shadow.paint(canvas, card, kCorner);
    }
    if (hasCard) {
        painter.fillPath(roundedPath(card, kCorner), palette().card);
    }
    return image;
}

/// The most by which a pixel differs in any colour.
int mostDifference(const QImage& one, const QImage& other) {
    int most = 0;
    for (int y = 0; y < one.height(); ++y) {
        for (int x = 0; x < one.width(); ++x) {
            const QRgb a = one.pixel(x, y);
            const QRgb b = other.pixel(x, y);
            for (const int shift : {0, 8, 16, 24}) {
                const auto part = [shift](QRgb color) { return static_cast<int>(color >> shift & 0xFFU); };
                most = std::max(most, std::abs(part(a) - part(b)));
            }
        }
    }
    return most;
}

TEST(CardShadowTest, AroundAnOpaqueCard_LooksAsIfAllOfItWerePainted) {
    for (const double scale : {1.0, 1.25, 2.0, 3.0}) {
        for (const QRectF& card : {QRectF(30, 30, 400, 1000), QRectF(40.3, 33.7, 301.4, 840.6), QRectF(50, 50, 120, 90),
                                   QRectF(60, 60, 50, 44), QRectF(16, -300, 380, 1500)}) {
            EXPECT_EQ(mostDifference(painted(true, card, scale, 1.0), painted(false, card, scale, 1.0)), 0)
                << "scale " << scale << ", " << card.width() << " x " << card.height();
        }
    }
}

TEST(CardShadowTest, UnderACardThatFades_AllOfItIsPainted) {
    const QRectF card(30, 30, 400, 1000);
    EXPECT_EQ(painted(true, card, 2.0, 0.5), painted(false, card, 2.0, 0.5));
}

TEST(CardShadowTest, AroundAnOpaqueCard_NearlyNothingIsPaintedUnderIt) {
    const QRectF card(30, 30, 400, 1000);
    const auto share = [&](bool isAround) {
        const QImage image = painted(isAround, card, 1.0, 1.0, false);
        int count = 0;
        for (int y = 50; y < 1010; ++y) {
            for (int x = 32; x < 428; ++x) {
                count += qAlpha(image.pixel(x, y)) > 0 ? 1 : 0;
            }
        }
        return count / (960.0 * 396.0);
    };
    EXPECT_GT(share(false), 0.95);
    // The corners of the wide shadow are painted as a whole.
    EXPECT_LT(share(true), 0.08);
}

}  // namespace
}  // namespace ktr::host
