#include "linux/maps/LabelHalo.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <QPainterPath>
#include <QPainterPathStroker>
#include <algorithm>
#include <cmath>

#include "linux/paint/FontChoice.h"
#include "platform/ui/Font.h"

namespace ktr::linux_ {

namespace {

constexpr int kPixels = 64;
constexpr int kSide = 160;
constexpr QPointF kOrigin(40.0, 110.0);
/// What the pixels at the halo's edge may be either way: half their diagonal, and what rounded corners lose.
constexpr double kEdge = 0.95;

QImage drawn(const QPainterPath& path) {
    QImage image(kSide, kSide, QImage::Format_Grayscale8);
    image.fill(0);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.translate(kOrigin);
    painter.fillPath(path, Qt::white);
    return image;
}

QPainterPath filled(const QList<QPolygonF>& rings) {
    QPainterPath path;
    path.setFillRule(Qt::WindingFill);
    for (const auto& ring : rings) {
        path.addPolygon(ring);
        path.closeSubpath();
    }
    return path;
}

/// How far a point is from the ink; pixels.
double awayFrom(const QList<QPolygonF>& rings, const QPainterPath& letter, const QPointF& point) {
    if (letter.contains(point)) {
        return 0.0;
    }
    double nearest = 1e9;
    for (const auto& ring : rings) {
        for (qsizetype i = 0; i < ring.size(); ++i) {
            const QPointF from = ring[i];
            const QPointF along = ring[i + 1 == ring.size() ? 0 : i + 1] - from;
            const double length = QPointF::dotProduct(along, along);
            const double share =
                length > 0.0 ? std::clamp(QPointF::dotProduct(point - from, along) / length, 0.0, 1.0) : 0.0;
            const QPointF step = point - from - along * share;
            nearest = std::min(nearest, std::hypot(step.x(), step.y()));
        }
    }
    return nearest;
}

/// The toolkit's own way: the letter, and a stroke of twice the width around it.
QPainterPath stroked(const QPainterPath& letter, double distance) {
    QPainterPathStroker stroker;
    stroker.setWidth(2.0 * distance);
    stroker.setCapStyle(Qt::RoundCap);
    stroker.setJoinStyle(Qt::RoundJoin);
    QPainterPath path = stroker.createStroke(letter);
    path.addPath(letter);
    path.setFillRule(Qt::WindingFill);
    return path;
}

QPainterPath letterOf(QChar character) {
    QPainterPath path;
    path.addText(0.0, 0.0, FontChoice::spec(platform::Font(), kPixels, FontChoice::baseFamily()).font(),
                 QString(character));
    return path;
}

}  // namespace

TEST(LabelHaloTest, Letters_HaveAllThatIsNearThemAndNoMore) {
    for (const QChar character : QStringLiteral("abegkmosQRW&8%äßжшФאבשثञあ国")) {
        const QPainterPath letter = letterOf(character);
        ASSERT_FALSE(letter.isEmpty());
        const auto rings = letter.toSubpathPolygons();
        for (const double distance : {2.0, 8.5, 14.0}) {
            const QImage image = drawn(filled(LabelHalo::around(rings, distance)));
            int wrong = 0;
            for (int y = 0; y < kSide; ++y) {
                for (int x = 0; x < kSide; ++x) {
                    const double away = awayFrom(rings, letter, QPointF(x + 0.5, y + 0.5) - kOrigin);
                    const int level = qGray(image.pixel(x, y));
                    wrong += (away < distance - kEdge && level < 255) || (away > distance + kEdge && level > 0) ? 1 : 0;
                }
            }
            EXPECT_EQ(wrong, 0) << QString(character).toStdString() << " at " << distance;
        }
    }
}

TEST(LabelHaloTest, ItHasAFractionOfTheEdgesOfAStroke) {
    int edges = 0;
    int strokeEdges = 0;
    for (const QChar character : QStringLiteral("Harbour Road and Quay Street")) {
        const QPainterPath letter = letterOf(character);
        edges += filled(LabelHalo::around(letter.toSubpathPolygons(), 8.5)).elementCount();
        strokeEdges += filled(stroked(letter, 8.5).toSubpathPolygons()).elementCount();
    }
    EXPECT_LT(edges * 3, strokeEdges * 2);
}

TEST(LabelHaloTest, RingsThatTurnTheOtherWay_GrowOutwardsToo) {
    const QPolygonF square({{0.0, 0.0}, {20.0, 0.0}, {20.0, 20.0}, {0.0, 20.0}});
    const QPolygonF turned(square.crbegin(), square.crend());
    for (const QPolygonF& ring : {square, turned}) {
        EXPECT_EQ(filled(LabelHalo::around({ring}, 3.0)).boundingRect(), QRectF(-3.0, -3.0, 26.0, 26.0));
    }
}

TEST(LabelHaloTest, RingsWithoutASurface_HaveNone) {
    EXPECT_TRUE(LabelHalo::around({}, 3.0).isEmpty());
    EXPECT_TRUE(LabelHalo::around({QPolygonF({{1.0, 1.0}, {1.0, 1.0}, {2.0, 2.0}, {1.0, 1.0}})}, 3.0).isEmpty());
}

}  // namespace ktr::linux_
