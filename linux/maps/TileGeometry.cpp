#include "linux/maps/TileGeometry.h"

#include <algorithm>
#include <cmath>

namespace ktr::linux_ {

namespace {

/// One side of a window: what lies on its good side has a distance of 0 or more.
struct Side {
    bool isVertical;
    double position;
    double sign;

    double distance(const QPointF& point) const { return ((isVertical ? point.x() : point.y()) - position) * sign; }
};

/// Sutherland and Hodgman's way: the part of a ring on one side of a line.
void cutRing(QPolygonF& ring, const Side& side) {
    QPolygonF kept;
    kept.reserve(ring.size() + 4);
    for (qsizetype index = 0; index < ring.size(); ++index) {
        const QPointF& from = ring[index];
        const QPointF& to = ring[index + 1 == ring.size() ? 0 : index + 1];
        const double before = side.distance(from);
        const double after = side.distance(to);
        if (before >= 0.0) {
            kept.append(from);
        }
        if ((before >= 0.0) != (after >= 0.0)) {
            QPointF crossing = from + (to - from) * (before / (before - after));
            // Exactly on the line, so that neighbours meet.
            (side.isVertical ? crossing.rx() : crossing.ry()) = side.position;
            kept.append(crossing);
        }
    }
    ring = std::move(kept);
}

/// Liang and Barsky's way: the part of a segment inside a rectangle, as shares of its length. False when there is none.
bool cutSegment(const QPointF& from, const QPointF& to, const QRectF& window, double& begin, double& end) {
    begin = 0.0;
    end = 1.0;
    const QPointF along = to - from;
    const double moves[] = {-along.x(), along.x(), -along.y(), along.y()};
    const double rooms[] = {from.x() - window.left(), window.right() - from.x(), from.y() - window.top(),
                            window.bottom() - from.y()};
    for (int side = 0; side < 4; ++side) {
        if (moves[side] == 0.0) {
            if (rooms[side] < 0.0) {
                return false;
            }
        } else if (const double share = rooms[side] / moves[side]; moves[side] < 0.0) {
            begin = std::max(begin, share);
        } else {
            end = std::min(end, share);
        }
    }
    return begin < end;
}

/// Whether an edge of an area runs along the tile's own edge: there the tile was cut, not the area.
bool isCut(const tiles::MapTile::Spot& from, const tiles::MapTile::Spot& to) {
    const auto onEdge = [](float a, float b) { return a == b && (a <= 0.0F || a >= tiles::MapTile::kExtent); };
    return onEdge(from.x, to.x) || onEdge(from.y, to.y);
}

}  // namespace

TileGeometry::TileGeometry(const VisibleTile& visible)
    : visible_(visible), unit_(visible.square.width() / static_cast<double>(tiles::MapTile::kExtent)) {}

bool TileGeometry::isVisible(const tiles::MapTile::Feature& feature) const {
    const QPointF first = point({feature.left, feature.top});
    const QPointF last = point({feature.right, feature.bottom});
    const QRectF& window = visible_.window;
    return first.x() <= window.right() && last.x() >= window.left() && first.y() <= window.bottom() &&
           last.y() >= window.top();
}

bool TileGeometry::isInside(const tiles::MapTile::Feature& feature) const {
    const QPointF first = point({feature.left, feature.top});
    const QPointF last = point({feature.right, feature.bottom});
    const QRectF& window = visible_.window;
    return first.x() >= window.left() && last.x() <= window.right() && first.y() >= window.top() &&
           last.y() <= window.bottom();
}

void TileGeometry::addArea(const tiles::MapTile::Feature& feature, QPainterPath& path) const {
    const tiles::MapTile& tile = *visible_.tile;
    const QRectF& window = visible_.window;
    const Side sides[] = {{true, window.left(), 1.0},
                          {true, window.right(), -1.0},
                          {false, window.top(), 1.0},
                          {false, window.bottom(), -1.0}};
    const bool isWhole = isInside(feature);
    for (std::uint32_t part = feature.firstPart; part < feature.firstPart + feature.partCount; ++part) {
        QPolygonF ring;
        ring.reserve(tile.partEnds[part] - tile.partBegin(part) + 1);
        for (std::uint32_t spot = tile.partBegin(part); spot < tile.partEnds[part]; ++spot) {
            ring.append(point(tile.spots[spot]));
        }
        for (const Side& side : sides) {
            if (!isWhole && !ring.isEmpty()) {
                cutRing(ring, side);
            }
        }
        if (ring.size() >= 3) {
            path.addPolygon(ring);
            path.closeSubpath();
        }
    }
}

void TileGeometry::eachEdge(const tiles::MapTile::Feature& feature, const LineReceiver& receive) const {
    const tiles::MapTile& tile = *visible_.tile;
    for (std::uint32_t part = feature.firstPart; part < feature.firstPart + feature.partCount; ++part) {
        const std::uint32_t begin = tile.partBegin(part);
        const std::uint32_t end = tile.partEnds[part];
        QPolygonF line;
        for (std::uint32_t spot = begin; spot < end; ++spot) {
            const tiles::MapTile::Spot& from = tile.spots[spot];
            const tiles::MapTile::Spot& to = tile.spots[spot + 1 == end ? begin : spot + 1];
            if (isCut(from, to)) {
                cutLine(line, receive);
                line.clear();
                continue;
            }
            if (line.isEmpty()) {
                line.append(point(from));
            }
            line.append(point(to));
        }
        cutLine(line, receive);
    }
}

void TileGeometry::eachLine(const tiles::MapTile::Feature& feature, const LineReceiver& receive) const {
    const tiles::MapTile& tile = *visible_.tile;
    for (std::uint32_t part = feature.firstPart; part < feature.firstPart + feature.partCount; ++part) {
        QPolygonF line;
        line.reserve(tile.partEnds[part] - tile.partBegin(part));
        for (std::uint32_t spot = tile.partBegin(part); spot < tile.partEnds[part]; ++spot) {
            line.append(point(tile.spots[spot]));
        }
        cutLine(line, receive);
    }
}

void TileGeometry::cutLine(const QPolygonF& line, const LineReceiver& receive) const {
    QPolygonF piece;
    double pieceFrom = 0.0;
    double distance = 0.0;
    const auto finish = [&] {
        if (piece.size() >= 2) {
            receive(piece, pieceFrom);
        }
        piece.clear();
    };
    for (qsizetype index = 1; index < line.size(); ++index) {
        const QPointF& from = line[index - 1];
        const QPointF& to = line[index];
        const double length = std::hypot(to.x() - from.x(), to.y() - from.y());
        double begin = 0.0;
        double end = 0.0;
        if (cutSegment(from, to, visible_.window, begin, end)) {
            if (piece.isEmpty()) {
                piece.append(begin == 0.0 ? from : from + (to - from) * begin);
                pieceFrom = distance + length * begin;
            }
            piece.append(end == 1.0 ? to : from + (to - from) * end);
            if (end < 1.0) {
                finish();
            }
        } else {
            finish();
        }
        distance += length;
    }
    finish();
}

std::vector<QPointF> TileGeometry::spots(const tiles::MapTile::Feature& feature) const {
    const tiles::MapTile& tile = *visible_.tile;
    std::vector<QPointF> inside;
    for (std::uint32_t part = feature.firstPart; part < feature.firstPart + feature.partCount; ++part) {
        const QPointF spot = point(tile.spots[tile.partBegin(part)]);
        if (visible_.window.contains(spot)) {
            inside.push_back(spot);
        }
    }
    return inside;
}

}  // namespace ktr::linux_
