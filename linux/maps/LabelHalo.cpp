#include "linux/maps/LabelHalo.h"

#include <cmath>
#include <numbers>

namespace ktr::linux_ {

namespace {

/// Corners are rounded in steps of so many radians: a fiftieth of the distance is cut off at most.
constexpr double kRound = std::numbers::pi / 9.0;

double doubledArea(const QPolygonF& ring) {
    double area = 0.0;
    for (qsizetype i = 0; i < ring.size(); ++i) {
        const QPointF& a = ring[i];
        const QPointF& b = ring[i + 1 == ring.size() ? 0 : i + 1];
        area += a.x() * b.y() - b.x() * a.y();
    }
    return area;
}

/// Without points that are there twice in a row, which have no direction.
QPolygonF withoutDoubles(const QPolygonF& ring) {
    QPolygonF made;
    for (const QPointF& point : ring) {
        if (made.isEmpty() || made.last() != point) {
            made.append(point);
        }
    }
    while (made.size() > 1 && made.last() == made.first()) {
        made.removeLast();
    }
    return made;
}

/// The ring moved outwards edge by edge. Around a corner that sticks out goes an arc; from one edge to the next of a
/// corner that goes in the way leads through the corner itself. So the ring is the sum of the letter, a rectangle along
/// each edge and a sector at each corner, all turning one way: nothing inside is ever counted away.
QPolygonF moved(const QPolygonF& ring, double distance) {
    QPolygonF made;
    const qsizetype count = ring.size();
    for (qsizetype i = 0; i < count; ++i) {
        const QPointF& corner = ring[i];
        const QPointF before = corner - ring[i == 0 ? count - 1 : i - 1];
        const QPointF after = ring[i + 1 == count ? 0 : i + 1] - corner;
        const double from = std::atan2(-before.x(), before.y());
        const double turn = std::atan2(before.x() * after.y() - before.y() * after.x(),
                                       before.x() * after.x() + before.y() * after.y());
        const auto at = [&](double angle) { return corner + QPointF(std::cos(angle), std::sin(angle)) * distance; };
        if (turn * distance < 0.0) {
            made << at(from) << corner << at(from + turn);
            continue;
        }
        if (std::abs(turn) < kRound / 2.0) {
            made.append(at(from + turn / 2.0));  // the bends of a curve
            continue;
        }
        const int steps = static_cast<int>(std::ceil(std::abs(turn) / kRound));
        for (int step = 0; step <= steps; ++step) {
            made.append(at(from + turn * step / steps));
        }
    }
    return made;
}

}  // namespace

QList<QPolygonF> LabelHalo::around(const QList<QPolygonF>& rings, double distance) {
    double area = 0.0;
    for (const QPolygonF& ring : rings) {
        area += doubledArea(ring);
    }
    QList<QPolygonF> made;
    for (const QPolygonF& ring : rings) {
        const QPolygonF clean = withoutDoubles(ring);
        if (clean.size() >= 3) {
            made.append(moved(clean, area < 0.0 ? -distance : distance));
        }
    }
    return made;
}

}  // namespace ktr::linux_
