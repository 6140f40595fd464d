#include "linux/maps/MapLabels.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "linux/maps/MapStyle.h"

namespace ktr::linux_ {

namespace {

/// What names keep to the picture's edge, to a clear rectangle and to each other; points.
constexpr double kEdgeMargin = 4.0;
constexpr double kClearMargin = 2.0;
constexpr double kLabelMargin = 3.0;
/// Half the height of a letter x, in sizes: a name along a street stands with the middle of its small letters on it.
constexpr double kMiddle = 0.34;
constexpr double kSlant = 0.2;
/// How far a name's beginning and end stay from the ends of its line; points.
constexpr double kLineMargin = 3.0;
/// Steps in which a place along a line is looked for; points.
constexpr double kStep = 9.0;
constexpr int kMostSteps = 60;
/// A street that falls more steeply than this is read upwards; radians from the horizontal.
constexpr double kSteepest = 72.0 * std::numbers::pi / 180.0;
/// How much two neighbouring letters may differ in direction; radians. The first is tried everywhere before the second.
constexpr double kBends[] = {0.12, 0.42};
/// How much a whole name may turn; radians.
constexpr double kMostTurn = 1.3;

/// A line by the distance from its beginning.
struct Ruler {
    const QPolygonF& line;
    const std::vector<double>& ends;  ///< the distance at each point

    QPointF at(double distance) const {
        const auto found = std::lower_bound(ends.begin(), ends.end(), distance);
        const auto index =
            std::clamp<std::ptrdiff_t>(found - ends.begin(), 1, static_cast<std::ptrdiff_t>(ends.size()) - 1);
        const double from = ends[static_cast<std::size_t>(index - 1)];
        const double length = ends[static_cast<std::size_t>(index)] - from;
        const double share = length > 0.0 ? (distance - from) / length : 0.0;
        return line[index - 1] + (line[index] - line[index - 1]) * share;
    }
    double direction(double from, double to) const {
        const QPointF along = at(to) - at(from);
        return std::atan2(along.y(), along.x());
    }
};

double turn(double from, double to) {
    return std::abs(std::remainder(to - from, 2.0 * std::numbers::pi));
}

}  // namespace

MapLabels::MapLabels(const MapDrawing& drawing, LabelShaper& shaper)
    : drawing_(drawing),
      shaper_(shaper),
      room_(QRectF(0.0, 0.0, drawing.request.viewport.size.width, drawing.request.viewport.size.height)
                .adjusted(kEdgeMargin, kEdgeMargin, -kEdgeMargin, -kEdgeMargin)),
      isWhole_(drawing.region == QRegion(QRect(QPoint(), drawing.pixels))) {
    for (const auto& rect : drawing.request.clear) {
        taken_.push_back(QRectF(rect.x, rect.y, rect.width, rect.height)
                             .adjusted(-kClearMargin, -kClearMargin, kClearMargin, kClearMargin));
    }
}

MapLabels::Text MapLabels::text(const std::string& name, const LabelLook& look) {
    Text made;
    made.look = look;
    made.glyphs = shaper_.shape(name, {look.isBold, MapStyle::kHaloWidth / look.size, drawing_.request.language});
    if (!made.glyphs) {
        return made;
    }
    const double spacing = made.glyphs->isJoined ? 0.0 : look.spacing;
    double before = 0.0;
    double lastAdvance = 0.0;
    for (const auto& glyph : made.glyphs->glyphs) {
        // Marks that stand on a letter do not move away from it.
        before += lastAdvance > 0.0 && glyph.advance > 0.0 ? spacing : 0.0;
        lastAdvance = std::max(lastAdvance, glyph.advance);
        made.lefts.push_back(glyph.x * look.size + before);
    }
    made.width = made.glyphs->width * look.size + before;
    made.rise = kMiddle * look.size;
    return made;
}

QSizeF MapLabels::sizeOf(const std::string& name, const LabelLook& look) {
    const Text measured = text(name, look);
    return measured.glyphs ? QSizeF(measured.width + MapStyle::kHaloWidth, look.size * 1.2 + MapStyle::kHaloWidth)
                           : QSizeF();
}

bool MapLabels::isFree(const QRectF& box) const {
    if (!room_.contains(box)) {
        return false;
    }
    if (std::any_of(taken_.begin(), taken_.end(), [&](const QRectF& other) { return other.intersects(box); })) {
        return false;
    }
    if (isWhole_) {
        return true;
    }
    const double scale = drawing_.pixels.width() / drawing_.request.viewport.size.width;
    const QRectF pixels(box.x() * scale, box.y() * scale, box.width() * scale, box.height() * scale);
    return QRegion(pixels.toAlignedRect()).subtracted(drawing_.region).isEmpty();
}

bool MapLabels::isFree(const std::vector<QRectF>& boxes) const {
    return std::all_of(boxes.begin(), boxes.end(), [&](const QRectF& box) { return isFree(box); });
}

std::vector<MapLabels::Stand> MapLabels::straight(const Text& text, const QPointF& middle, double angle) const {
    std::vector<Stand> stands;
    const QPointF along(std::cos(angle), std::sin(angle));
    const QPointF down(-along.y(), along.x());
    for (std::size_t index = 0; index < text.lefts.size(); ++index) {
        const double x = text.lefts[index] - text.width / 2.0;
        const double y = text.rise + text.glyphs->glyphs[index].y * text.look.size;
        stands.push_back({middle + along * x + down * y, angle});
    }
    return stands;
}

/// The upright boxes around each letter with its halo: small enough that the empty corners beside a slanting name stay
/// free for others.
std::vector<QRectF> MapLabels::boxes(const Text& text, const std::vector<Stand>& stands) const {
    std::vector<QRectF> made;
    const double halo = MapStyle::kHaloWidth / 2.0;
    for (std::size_t index = 0; index < stands.size(); ++index) {
        const auto& glyph = text.glyphs->glyphs[index];
        if (glyph.ink.isEmpty()) {
            continue;
        }
        const double grown = halo / text.look.size;
        made.push_back(transform(text, stands[index]).mapRect(glyph.ink.adjusted(-grown, -grown, grown, grown)));
    }
    return made;
}

QTransform MapLabels::transform(const Text& text, const Stand& stand) {
    QTransform made;
    made.translate(stand.origin.x(), stand.origin.y());
    made.rotateRadians(stand.angle);
    if (text.look.isSlanted) {
        made.shear(-kSlant, 0.0);
    }
    made.scale(text.look.size, text.look.size);
    return made;
}

void MapLabels::put(const Text& text, std::vector<Stand> stands, const std::vector<QRectF>& boxes) {
    placed_.push_back({text, std::move(stands)});
    for (const auto& box : boxes) {
        taken_.push_back(box.adjusted(-kLabelMargin, -kLabelMargin, kLabelMargin, kLabelMargin));
    }
}

bool MapLabels::placeAt(const std::string& name, const LabelLook& look, const QPointF& middle) {
    const Text made = text(name, look);
    if (!made.glyphs) {
        return false;
    }
    const auto stands = straight(made, middle, 0.0);
    const auto letters = boxes(made, stands);
    if (!isFree(letters)) {
        return false;
    }
    put(made, stands, letters);
    return true;
}

bool MapLabels::placeAlong(const std::string& name, const LabelLook& look, const QPolygonF& line) {
    const Text made = text(name, look);
    if (!made.glyphs || line.size() < 2) {
        return false;
    }
    std::vector<double> ends{0.0};
    for (qsizetype index = 1; index < line.size(); ++index) {
        const QPointF step = line[index] - line[index - 1];
        ends.push_back(ends.back() + std::hypot(step.x(), step.y()));
    }
    const double slack = ends.back() - made.width - 2.0 * kLineMargin;
    if (slack < 0.0) {
        return false;
    }
    const int steps = std::min(kMostSteps, static_cast<int>(slack / 2.0 / kStep));
    for (const double bend : kBends) {
        for (int step = 0; step <= steps; ++step) {
            for (const double side : {-1.0, 1.0}) {
                if (tryAlong(made, line, ends, ends.back() / 2.0 + side * step * kStep, bend)) {
                    return true;
                }
                if (step == 0) {
                    break;
                }
            }
        }
    }
    return false;
}

bool MapLabels::tryAlong(const Text& text, const QPolygonF& line, const std::vector<double>& ends, double middle,
                         double mostBend) {
    const Ruler ruler{line, ends};
    const double begin = middle - text.width / 2.0;
    const double end = middle + text.width / 2.0;
    if (!room_.contains(ruler.at(begin)) || !room_.contains(ruler.at(end))) {
        return false;
    }
    const double overall = ruler.direction(begin, end);
    // Read from left to right, and steep streets upwards.
    const bool isTurned = overall > kSteepest || overall <= kSteepest - std::numbers::pi;
    const auto directionOf = [&](double from, double to) {
        return isTurned ? ruler.direction(end - (from - begin), end - (to - begin)) : ruler.direction(from, to);
    };
    std::vector<Stand> stands;
    double last = isTurned ? overall + std::numbers::pi : overall;
    const double whole = last;
    if (text.glyphs->isJoined) {
        const double third = text.width / 3.0;
        for (int part = 0; part < 3; ++part) {
            if (turn(whole, directionOf(begin + part * third, begin + (part + 1) * third)) > mostBend) {
                return false;
            }
        }
        stands = straight(text, (ruler.at(begin) + ruler.at(end)) / 2.0, whole);
    } else {
        for (std::size_t index = 0; index < text.lefts.size(); ++index) {
            const auto& glyph = text.glyphs->glyphs[index];
            const double advance = glyph.advance * text.look.size;
            const double centre = begin + text.lefts[index] + advance / 2.0;
            const double reach = std::max(advance / 2.0, text.look.size * 0.35);
            const double from = std::max(begin, centre - reach);
            const double to = std::min(end, centre + reach);
            const double angle = from < to ? directionOf(from, to) : last;
            if ((index > 0 && turn(last, angle) > mostBend) || turn(whole, angle) > kMostTurn) {
                return false;
            }
            last = angle;
            const QPointF on = ruler.at(isTurned ? end - (centre - begin) : centre);
            const QPointF along(std::cos(angle), std::sin(angle));
            const QPointF down(-along.y(), along.x());
            stands.push_back({on - along * (advance / 2.0) + down * (text.rise + glyph.y * text.look.size), angle});
        }
    }
    const auto letters = boxes(text, stands);
    if (!isFree(letters)) {
        return false;
    }
    put(text, stands, letters);
    return true;
}

void MapLabels::draw(QPainter& painter) const {
    for (const bool isHalo : {true, false}) {
        for (const auto& [text, stands] : placed_) {
            for (std::size_t index = 0; index < stands.size(); ++index) {
                const auto& glyph = text.glyphs->glyphs[index];
                painter.fillPath(transform(text, stands[index]).map(isHalo ? glyph.halo : glyph.outline),
                                 isHalo ? text.look.halo : text.look.color);
            }
        }
    }
}

}  // namespace ktr::linux_
