#include "linux/maps/WorldGround.h"

#include <algorithm>
#include <array>
#include <cmath>

#include <QPainterPath>
#include <QPolygonF>

#include "linux/maps/MapStyle.h"
#include "linux/maps/MapText.h"
#include "linux/maps/WorldNames.h"
#include "platform/map/Mercator.h"

namespace ktr::linux_ {

namespace {

/// Lines reach beyond the picture by this, so that their ends are not seen; points.
constexpr double kMargin = 16.0;
constexpr double kDotRadius = 2.2;
constexpr double kLabelGap = 4.0;
/// What the shorter side of a map shows that is the finest with a town to name; metres.
constexpr std::array<double, 5> kCoarseSides = {20000.0, 25000.0, 32000.0, 40000.0, 50000.0};
/// On maps of up to this, the nearest town is named whatever stands on it, and towns have marks that are seen; metres.
constexpr double kNearSide = 50500.0;
constexpr double kTownRadius = 3.2;
constexpr double kTownEdge = 1.6;
/// A country's name goes when the country is this many zooms larger than its name.
constexpr double kCountryZooms = 4.5;
constexpr double kZoomsBeforeRounding = 1.5;
/// Borders are dashed from this zoom on.
constexpr double kDashedFrom = 4.0;

double shorterSide(const platform::MapViewport& viewport) {
    return std::min(viewport.size.width, viewport.size.height) * viewport.metresPerPoint();
}

/// Where the world stands in the picture.
struct Frame {
    QPointF centre;  ///< of the picture, in the world's square
    double side = 256.0;
    QSizeF size;
    QRectF seen;  ///< part of the world in the picture and its margin

    explicit Frame(const platform::MapViewport& viewport)
        : side(platform::mercatorWorld(viewport.zoom)), size(viewport.size.width, viewport.size.height) {
        const platform::Point middle = platform::mercatorPoint(viewport.centre);
        centre = {middle.x, middle.y};
        const double width = (size.width() / 2.0 + kMargin) / side;
        const double height = (size.height() / 2.0 + kMargin) / side;
        seen = QRectF(centre.x() - width, centre.y() - height, 2.0 * width, 2.0 * height);
    }
    QPointF pointFor(QPointF place) const {
        return {(place.x() - centre.x()) * side + size.width() / 2.0,
                (place.y() - centre.y()) * side + size.height() / 2.0};
    }
    // Land that crosses the date line reaches into the next copy of the world.
    int firstCopy() const { return static_cast<int>(std::floor(seen.left())) - 1; }
    int lastCopy() const { return static_cast<int>(std::floor(seen.right())) + 1; }
};

bool meet(const QRectF& a, const QRectF& b) {
    return a.left() <= b.right() && b.left() <= a.right() && a.top() <= b.bottom() && b.top() <= a.bottom();
}

/// Sutherland and Hodgman's clipping, an edge at a time: what is far outside would be too far for the rasteriser.
QPolygonF clipped(QPolygonF polygon, const QRectF& window) {
    using Distance = double (*)(const QPointF&, const QRectF&);
    static constexpr std::array<Distance, 4> kDistances = {
        [](const QPointF& p, const QRectF& r) { return p.x() - r.left(); },
        [](const QPointF& p, const QRectF& r) { return r.right() - p.x(); },
        [](const QPointF& p, const QRectF& r) { return p.y() - r.top(); },
        [](const QPointF& p, const QRectF& r) { return r.bottom() - p.y(); }};
    for (const Distance distance : kDistances) {
        QPolygonF kept;
        kept.reserve(polygon.size() + 8);
        for (qsizetype i = 0; i < polygon.size(); ++i) {
            const QPointF& here = polygon[i];
            const QPointF& before = polygon[i == 0 ? polygon.size() - 1 : i - 1];
            const double inside = distance(here, window);
            const double wasInside = distance(before, window);
            if ((inside >= 0.0) != (wasInside >= 0.0)) {
                kept.append(before + (here - before) * (wasInside / (wasInside - inside)));
            }
            if (inside >= 0.0) {
                kept.append(here);
            }
        }
        polygon = std::move(kept);
    }
    return polygon;
}

/// The stretches of a line in sight with all their points; of the others the ends alone, which lie on one side of the
/// window and so change nothing inside it.
QPolygonF reduced(const WorldMap::Line& line, const QRectF& window) {
    QPolygonF points;
    for (std::size_t s = 0; s < line.stretches.size(); ++s) {
        const std::size_t first = s * WorldMap::Line::kStretch;
        const std::size_t last = std::min(line.points.size(), first + WorldMap::Line::kStretch) - 1;
        if (!meet(line.stretches[s], window)) {
            points.append(line.points[first]);
            points.append(line.points[last]);
            continue;
        }
        for (std::size_t i = first; i <= last; ++i) {
            points.append(line.points[i]);
        }
    }
    return points;
}

/// Chaikin's corner cutting: each edge keeps its middle half.
QPolygonF rounded(const QPolygonF& points, bool closed) {
    const qsizetype count = points.size();
    if (count < 3) {
        return points;
    }
    QPolygonF made;
    made.reserve(2 * count);
    if (!closed) {
        made.append(points.front());
    }
    for (qsizetype i = 0; i + (closed ? 0 : 1) < count; ++i) {
        const QPointF& a = points[i];
        const QPointF& b = points[i + 1 == count ? 0 : i + 1];
        made.append(a * 0.75 + b * 0.25);
        made.append(a * 0.25 + b * 0.75);
    }
    if (!closed) {
        made.append(points.back());
    }
    return made;
}

/// The way to the pole and back, and a cut along the date line, are no shore.
bool isSeam(const QPointF& a, const QPointF& b) {
    const auto isDateLine = [](double x) { return std::abs(x) < 1e-9 || std::abs(x - 1.0) < 1e-9; };
    return a.y() > 1.0 || b.y() > 1.0 || (isDateLine(a.x()) && isDateLine(b.x()));
}

class Drawer {
  public:
    Drawer(const MapDrawing& drawing, const WorldMap& map)
        : drawing_(drawing),
          map_(map),
          frame_(drawing.request.viewport),
          style_(MapStyle::of(drawing.request.isDark, drawing.request.isHighContrast)),
          level_(map.levelFor(drawing.request.viewport.zoom + drawing.request.scale / 4.0)),
          names_(drawing.request.language),
          language_(QString::fromStdString(drawing.request.language)),
          isNear_(shorterSide(drawing.request.viewport) <= kNearSide) {
        for (const platform::Rect& rect : drawing.request.clear) {
            taken_.emplace_back(rect.x, rect.y, rect.width, rect.height);
        }
    }

    void draw() {
        QPainter& painter = drawing_.painter;
        painter.fillRect(QRectF(QPointF(), frame_.size), style_.water);
        drawLand();
        drawBorders();
        drawCountries();
        drawTowns();
    }
    /// Whether a map of a few towns has the nearest of them in it, with room for its name. Nothing is drawn.
    bool hasTown() {
        isTrial_ = true;
        forCopies([&](const QRectF& window, QPointF shift) { findNearest(window, shift); });
        return nearest_ && drawNearest(*nearest_);
    }

  private:
    template <typename Each>
    void forCopies(Each each) const {
        for (int copy = frame_.firstCopy(); copy <= frame_.lastCopy() && !drawing_.stop.stop_requested(); ++copy) {
            each(frame_.seen.translated(-copy, 0.0), QPointF(copy, 0.0));
        }
    }

    QPolygonF inSight(const WorldMap::Line& line, const QRectF& window, bool closed) const {
        QPolygonF points = reduced(line, window);
        // Closer than the data goes, its corners would look like facts.
        const bool isClose = drawing_.request.viewport.zoom >= level_.zoom + kZoomsBeforeRounding;
        const bool isPole = line.bounds.bottom() > 1.0;
        return isClose && !isPole ? rounded(rounded(points, closed), closed) : points;
    }

    void drawLand() {
        QPainterPath land;
        std::vector<QPainterPath> shores;
        land.setFillRule(Qt::OddEvenFill);
        forCopies([&](const QRectF& window, QPointF shift) {
            for (const WorldMap::Line& shore : level_.shores) {
                if (!meet(shore.bounds, window)) {
                    continue;
                }
                const QPolygonF line = inSight(shore, window, true);
                QPolygonF polygon = clipped(line, window);
                for (QPointF& point : polygon) {
                    point = frame_.pointFor(point + shift);
                }
                if (polygon.size() >= 3) {
                    land.addPolygon(polygon);
                    land.closeSubpath();
                }
                addLine(shores.emplace_back(), line, window, shift, true);
            }
        });
        drawing_.painter.fillPath(land, style_.land);
        const QPen pen(style_.shore, MapStyle::kShoreWidth, Qt::SolidLine, Qt::FlatCap, Qt::BevelJoin);
        for (const QPainterPath& shore : shores) {
            drawing_.painter.strokePath(shore, pen);
        }
    }

    void drawBorders() {
        QPainterPath borders;
        forCopies([&](const QRectF& window, QPointF shift) {
            for (const WorldMap::Line& border : level_.borders) {
                if (meet(border.bounds, window)) {
                    addLine(borders, inSight(border, window, false), window, shift, false);
                }
            }
        });
        const double zoom = drawing_.request.viewport.zoom;
        // The whole world's borders are close together: there they are finer, or they would be all that is seen.
        const double width = MapStyle::kBoundaryWidth * std::clamp(0.5 + zoom / kDashedFrom * 0.5, 0.5, 1.0);
        QPen pen(style_.boundary, width, Qt::SolidLine, Qt::FlatCap, Qt::RoundJoin);
        if (zoom >= kDashedFrom) {
            // Dashes are in widths. Further out they would be longer than many a border.
            pen.setDashPattern({7.0 / MapStyle::kBoundaryWidth, 3.0 / MapStyle::kBoundaryWidth,
                                1.5 / MapStyle::kBoundaryWidth, 3.0 / MapStyle::kBoundaryWidth});
        }
        drawing_.painter.strokePath(borders, pen);
    }

    /// The edges of a line, or of a closed one, that are in sight.
    void addLine(QPainterPath& path, const QPolygonF& points, const QRectF& window, QPointF shift, bool closed) const {
        bool isDown = false;
        const qsizetype count = points.size();
        for (qsizetype i = 0; i + (closed ? 0 : 1) < count; ++i) {
            const QPointF& a = points[i];
            const QPointF& b = points[i + 1 == count ? 0 : i + 1];
            const QRectF box(QPointF(std::min(a.x(), b.x()), std::min(a.y(), b.y())),
                             QPointF(std::max(a.x(), b.x()), std::max(a.y(), b.y())));
            if (isSeam(a, b) || !meet(box, window)) {
                isDown = false;
                continue;
            }
            addEdge(path, a, b, window, shift, isDown);
        }
    }

    /// One edge, cut where it leaves the window.
    void addEdge(QPainterPath& path, QPointF a, QPointF b, const QRectF& window, QPointF shift, bool& isDown) const {
        double from = 0.0;
        double to = 1.0;
        const QPointF way = b - a;
        const std::array<std::pair<double, double>, 4> sides = {{{-way.x(), a.x() - window.left()},
                                                                 {way.x(), window.right() - a.x()},
                                                                 {-way.y(), a.y() - window.top()},
                                                                 {way.y(), window.bottom() - a.y()}}};
        for (const auto& [p, q] : sides) {
            if (p < 0.0) {
                from = std::max(from, q / p);
            } else if (p > 0.0) {
                to = std::min(to, q / p);
            } else if (q < 0.0) {
                to = -1.0;
            }
        }
        if (from > to) {
            isDown = false;
            return;
        }
        if (!isDown || from > 0.0) {
            path.moveTo(frame_.pointFor(a + way * from + shift));
        }
        path.lineTo(frame_.pointFor(a + way * to + shift));
        isDown = to >= 1.0;
    }

    void drawCountries() {
        const double zoom = drawing_.request.viewport.zoom;
        forCopies([&](const QRectF& window, QPointF shift) {
            for (const WorldMap::Country& country : map_.countries()) {
                if (zoom < country.zoom || zoom > country.zoom + kCountryZooms || !window.contains(country.middle)) {
                    continue;
                }
                const MapText text(QString::fromStdString(names_.country(country)), language_,
                                   {zoom >= country.zoom + 1.0 ? 13 : 12, false, false});
                const QPointF middle = frame_.pointFor(country.middle + shift);
                place(text, middle + QPointF(-text.width() / 2.0, text.ascent() / 2.0 - text.descent() / 4.0),
                      style_.boundaryLabel);
            }
        });
    }

    void drawTowns() {
        const double zoom = drawing_.request.viewport.zoom;
        if (isNear_) {
            forCopies([&](const QRectF& window, QPointF shift) { findNearest(window, shift); });
            if (nearest_) {
                drawNearest(*nearest_);
            }
        }
        forCopies([&](const QRectF& window, QPointF shift) {
            for (const WorldMap::Town& town : map_.towns()) {
                const bool isNamed = nearest_ && nearest_->town == &town;
                if (zoom >= town.zoom && window.contains(town.place) && !isNamed) {
                    drawTown(town, frame_.pointFor(town.place + shift));
                }
            }
        });
    }

    /// The town in the picture that is nearest to its middle.
    struct Nearest {
        const WorldMap::Town* town = nullptr;
        QPointF spot;
        double distance = 0.0;
    };

    void findNearest(const QRectF& window, QPointF shift) {
        const QPointF middle(frame_.size.width() / 2.0, frame_.size.height() / 2.0);
        for (const WorldMap::Town& town : map_.towns()) {
            if (!window.contains(town.place)) {
                continue;
            }
            const QPointF spot = frame_.pointFor(town.place + shift);
            const double distance = std::hypot(spot.x() - middle.x(), spot.y() - middle.y());
            if (QRectF(QPointF(), frame_.size).contains(spot) && (!nearest_ || distance < nearest_->distance)) {
                nearest_ = Nearest{&town, spot, distance};
            }
        }
    }

    /// Its name beside it, or beside whatever stands on it: it is what says where the map is. Whether there was room.
    bool drawNearest(const Nearest& nearest) {
        constexpr int kSteps = 10;
        constexpr double kStep = 6.0;
        const MapText text(QString::fromStdString(names_.town(*nearest.town)), language_, {14, true, false});
        const QRectF dot = dotAt(nearest.spot);
        const bool isSeen = !isTaken(dot);
        for (int step = 0; step <= kSteps; ++step) {
            if (placeBeside(text, nearest.spot, kTownRadius + kTownEdge / 2.0 + step * kStep)) {
                if (isSeen) {
                    drawDot(nearest.spot);
                    taken_.push_back(dot);
                }
                return true;
            }
        }
        return false;
    }

    void drawTown(const WorldMap::Town& town, QPointF spot) {
        const QRectF dot = dotAt(spot);
        if (isTaken(dot)) {
            return;
        }
        const MapText text(QString::fromStdString(names_.town(town)), language_, {12, town.isCapital, false});
        if (placeBeside(text, spot, isNear_ ? kTownRadius + kTownEdge / 2.0 : kDotRadius)) {
            drawDot(spot);
            taken_.push_back(dot);
        }
    }

    QRectF dotAt(QPointF spot) const {
        const double radius = (isNear_ ? kTownRadius + kTownEdge / 2.0 : kDotRadius) + 1.0;
        return {spot.x() - radius, spot.y() - radius, 2.0 * radius, 2.0 * radius};
    }

    void drawDot(QPointF spot) {
        if (isTrial_) {
            return;
        }
        QPainter& painter = drawing_.labels;
        const double radius = isNear_ ? kTownRadius : kDotRadius;
        painter.setPen(isNear_ ? QPen(style_.label, kTownEdge) : QPen(style_.halo, 1.0));
        painter.setBrush(isNear_ ? style_.town : style_.label);
        painter.drawEllipse(spot, radius, radius);
    }

    /// Right of something round, left of it, above or below.
    bool placeBeside(const MapText& text, QPointF spot, double radius) {
        const double middle = text.ascent() / 2.0 - text.descent() / 2.0;
        const double side = radius + kLabelGap;
        const std::array<QPointF, 4> places = {QPointF(side, middle), QPointF(-side - text.width(), middle),
                                               QPointF(-text.width() / 2.0, -side - text.descent() / 2.0),
                                               QPointF(-text.width() / 2.0, side + text.ascent())};
        return std::any_of(places.begin(), places.end(),
                           [&](const QPointF& shift) { return place(text, spot + shift, style_.label); });
    }

    /// Draws the text if nothing is in its way and the picture shows it whole.
    bool place(const MapText& text, QPointF baseline, const QColor& ink) {
        constexpr double kHalf = MapStyle::kHaloWidth / 2.0;
        const QRectF box = text.ink().translated(baseline).adjusted(-kHalf, -kHalf, kHalf, kHalf);
        if (box.isEmpty() || isTaken(box)) {
            return false;
        }
        if (!isTrial_) {
            text.draw(drawing_.labels, baseline, ink, style_.halo, MapStyle::kHaloWidth);
        }
        taken_.push_back(box.adjusted(-2.0, -1.0, 2.0, 1.0));
        return true;
    }

    bool isTaken(const QRectF& box) const {
        const double scale = drawing_.pixels.width() / frame_.size.width();
        const QRect pixels =
            QRectF(box.x() * scale, box.y() * scale, box.width() * scale, box.height() * scale).toAlignedRect();
        if (!QRegion(pixels).subtracted(drawing_.region).isEmpty()) {
            return true;
        }
        return std::any_of(taken_.begin(), taken_.end(), [&](const QRectF& other) { return meet(other, box); });
    }

    const MapDrawing& drawing_;
    const WorldMap& map_;
    Frame frame_;
    const MapStyle& style_;
    const WorldMap::Level& level_;
    WorldNames names_;
    QString language_;
    std::vector<QRectF> taken_;
    bool isNear_;
    bool isTrial_ = false;
    std::optional<Nearest> nearest_;
};

}  // namespace

void WorldGround::read() {
    if (!isRead_) {
        isRead_ = true;
        map_ = WorldMap::readOrReport(file_, "Land without shores and names is drawn");
    }
}

std::optional<double> WorldGround::coarseZoom(const MapDrawing& drawing) {
    read();
    const auto& viewport = drawing.request.viewport;
    const double asked = shorterSide(viewport);
    if (asked > kNearSide) {
        return std::nullopt;
    }
    auto wider = drawing.request;
    for (const double side : kCoarseSides) {
        wider.viewport.zoom = viewport.zoom - std::max(std::log2(side / asked), 0.0);
        const MapDrawing trial{
            wider,       drawing.painter, drawing.labels, drawing.pixels, QRegion(QRect(QPoint(), drawing.pixels)),
            drawing.stop};
        if (map_ && Drawer(trial, *map_).hasTown()) {
            break;
        }
    }
    return wider.viewport.zoom < viewport.zoom ? std::optional(wider.viewport.zoom) : std::nullopt;
}

MapDrawn WorldGround::draw(const MapDrawing& drawing) {
    read();
    drawing.painter.save();
    QTransform toPixels = drawing.painter.transform();
    drawing.painter.resetTransform();
    drawing.painter.setClipRegion(drawing.region);
    drawing.painter.setTransform(toPixels);
    if (map_) {
        Drawer(drawing, *map_).draw();
    } else {
        const auto& style = MapStyle::of(drawing.request.isDark, drawing.request.isHighContrast);
        drawing.painter.fillRect(
            QRectF(0.0, 0.0, drawing.request.viewport.size.width, drawing.request.viewport.size.height), style.land);
    }
    drawing.painter.restore();
    return {drawing.region, kAttribution, true};
}

}  // namespace ktr::linux_
