#include "linux/maps/LineJoiner.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <utility>

namespace ktr::linux_ {

namespace {

/// Ends this near are one place; points.
constexpr double kNear = 0.75;
/// The sharpest turn on the way; radians.
constexpr double kSharpest = 0.9;
/// A name with more pieces than this is not one street.
constexpr std::size_t kMostPieces = 300;

double distance(const QPointF& a, const QPointF& b) {
    return std::hypot(a.x() - b.x(), a.y() - b.y());
}

double direction(const QPointF& from, const QPointF& to) {
    return std::atan2(to.y() - from.y(), to.x() - from.x());
}

void reverse(QPolygonF& line) {
    std::reverse(line.begin(), line.end());
}

/// Appends the piece that leads on most straightly; false when none does.
bool extend(QPolygonF& line, std::vector<QPolygonF>& pieces) {
    const double heading = direction(line[line.size() - 2], line.last());
    std::size_t best = pieces.size();
    double bestTurn = kSharpest;
    bool isReversed = false;
    for (std::size_t index = 0; index < pieces.size(); ++index) {
        const QPolygonF& piece = pieces[index];
        for (const bool reversed : {false, true}) {
            const QPointF& begin = reversed ? piece.last() : piece.first();
            if (distance(line.last(), begin) > kNear) {
                continue;
            }
            const QPointF& next = reversed ? piece[piece.size() - 2] : piece[1];
            const double turn = std::abs(std::remainder(direction(begin, next) - heading, 2.0 * std::numbers::pi));
            if (turn < bestTurn) {
                best = index;
                bestTurn = turn;
                isReversed = reversed;
            }
        }
    }
    if (best == pieces.size()) {
        return false;
    }
    if (isReversed) {
        reverse(pieces[best]);
    }
    for (qsizetype index = 1; index < pieces[best].size(); ++index) {
        line.append(pieces[best][index]);
    }
    pieces.erase(pieces.begin() + static_cast<std::ptrdiff_t>(best));
    return true;
}

}  // namespace

double lengthOf(const QPolygonF& line) {
    double length = 0.0;
    for (qsizetype index = 1; index < line.size(); ++index) {
        length += distance(line[index - 1], line[index]);
    }
    return length;
}

std::vector<QPolygonF> joinLines(std::vector<QPolygonF> pieces) {
    for (auto& piece : pieces) {
        QPolygonF clean;
        for (const auto& point : piece) {
            if (clean.isEmpty() || distance(clean.last(), point) > 1e-6) {
                clean.append(point);
            }
        }
        piece = std::move(clean);
    }
    std::erase_if(pieces, [](const QPolygonF& piece) { return piece.size() < 2; });
    const auto longer = [](const QPolygonF& a, const QPolygonF& b) { return lengthOf(a) > lengthOf(b); };
    std::stable_sort(pieces.begin(), pieces.end(), longer);
    pieces.resize(std::min(pieces.size(), kMostPieces));
    std::vector<QPolygonF> joined;
    while (!pieces.empty()) {
        QPolygonF line = std::move(pieces.front());
        pieces.erase(pieces.begin());
        while (extend(line, pieces)) {
        }
        reverse(line);
        while (extend(line, pieces)) {
        }
        reverse(line);
        joined.push_back(std::move(line));
    }
    std::stable_sort(joined.begin(), joined.end(), longer);
    return joined;
}

}  // namespace ktr::linux_
