#include "linux/maps/VectorLabels.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "linux/maps/LineJoiner.h"

namespace ktr::linux_ {

namespace {

constexpr double kMajorSize = 12.0;
constexpr double kSecondarySize = 11.5;
constexpr double kMinorSize = 10.5;
constexpr double kParkSize = 11.0;
constexpr double kWaterSize = 12.0;
constexpr double kSpacedLetters = 0.4;
/// More surfaces than this are not named in one picture.
constexpr std::size_t kMostAreas = 60;
/// Labels that are tried in one picture, and pieces of streets that they may stand along: several times what the
/// densest town has, and no more of what a file makes up to keep a worker busy.
constexpr int kMostTries = 1000;
constexpr std::size_t kMostStreetPieces = 10'000;
/// Where a label is tried in a surface: so many columns and rows of its visible part.
constexpr int kColumns = 9;
constexpr int kRows = 9;

bool isRoad(tiles::MapKind kind) {
    return kind == tiles::MapKind::Major || kind == tiles::MapKind::Secondary || kind == tiles::MapKind::Minor ||
           kind == tiles::MapKind::Service;
}

double areaOf(const QPolygonF& ring) {
    double doubled = 0.0;
    for (qsizetype index = 0; index < ring.size(); ++index) {
        const QPointF& a = ring[index];
        const QPointF& b = ring[index + 1 == ring.size() ? 0 : index + 1];
        doubled += a.x() * b.y() - b.x() * a.y();
    }
    return doubled / 2.0;
}

QPointF centroidOf(const QPainterPath& path) {
    QPointF sum;
    double total = 0.0;
    for (const QPolygonF& ring : path.toSubpathPolygons()) {
        const double area = areaOf(ring);
        const QPointF origin = ring.first();
        QPointF moment;
        for (qsizetype index = 0; index + 1 < ring.size(); ++index) {
            const QPointF a = ring[index] - origin;
            const QPointF b = ring[index + 1] - origin;
            moment += (a + b) * ((a.x() * b.y() - b.x() * a.y()) / 6.0);
        }
        sum += moment + origin * area;
        total += area;
    }
    return std::abs(total) > 1e-9 ? sum / total : path.boundingRect().center();
}

/// Whether the surface holds a label of this size: by nine points of it.
bool holds(const QPainterPath& path, const QPointF& middle, const QSizeF& size) {
    for (const double x : {-0.5, 0.0, 0.5}) {
        for (const double y : {-0.5, 0.0, 0.5}) {
            if (!path.contains(middle + QPointF(x * size.width(), y * size.height()))) {
                return false;
            }
        }
    }
    return true;
}

/// Places in the visible part of a surface, the middle first.
std::vector<QPointF> candidates(const QRectF& bounds, const QPointF& middle) {
    std::vector<QPointF> found;
    for (int row = 0; row < kRows; ++row) {
        for (int column = 0; column < kColumns; ++column) {
            found.emplace_back(bounds.x() + bounds.width() * (column + 0.5) / kColumns,
                               bounds.y() + bounds.height() * (row + 0.5) / kRows);
        }
    }
    const auto away = [&](const QPointF& point) {
        const QPointF step = point - middle;
        return step.x() * step.x() + step.y() * step.y();
    };
    std::stable_sort(found.begin(), found.end(), [&](const QPointF& a, const QPointF& b) { return away(a) < away(b); });
    found.insert(found.begin(), middle);
    return found;
}

}  // namespace

VectorLabels::VectorLabels(const MapDrawing& drawing, const std::vector<VisibleTile>& tiles, const MapScale& scale)
    : drawing_(drawing),
      tiles_(tiles),
      scale_(scale),
      style_(MapStyle::of(drawing.request.isDark, drawing.request.isHighContrast)) {}

LabelLook VectorLabels::lookOf(tiles::MapKind kind) const {
    LabelLook look{style_.label, style_.halo, kMinorSize * scale_.labelFactor()};
    switch (kind) {
        case tiles::MapKind::Major:
            look.size = kMajorSize * scale_.labelFactor();
            break;
        case tiles::MapKind::Secondary:
            look.size = kSecondarySize * scale_.labelFactor();
            break;
        case tiles::MapKind::Park:
        case tiles::MapKind::ParkName:
            look.color = style_.parkLabel;
            look.size = kParkSize * scale_.labelFactor();
            look.spacing = kSpacedLetters;
            break;
        case tiles::MapKind::Water:
        case tiles::MapKind::WaterName:
        case tiles::MapKind::WaterLine:
            look.color = style_.waterLabel;
            look.halo = style_.water;
            look.size = kWaterSize * scale_.labelFactor();
            look.spacing = kSpacedLetters;
            look.isSlanted = true;
            break;
        case tiles::MapKind::PointOfInterest:
            look.color = style_.pointOfInterest;
            break;
        case tiles::MapKind::BoundaryName:
            look.color = style_.boundaryLabel;
            break;
        default:
            break;
    }
    return look;
}

LabelLook VectorLabels::lookOf(tiles::PlaceRank rank) const {
    static constexpr std::array<double, 9> kSizes = {13.0, 11.5, 14.0, 14.0, 13.0, 12.0, 11.5, 10.5, 10.5};
    LabelLook look{style_.label, style_.halo, kSizes[static_cast<std::size_t>(rank)]};
    look.isBold = rank == tiles::PlaceRank::Capital || rank == tiles::PlaceRank::City;
    if (rank == tiles::PlaceRank::Country || rank == tiles::PlaceRank::State) {
        look.color = style_.boundaryLabel;
        look.spacing = 1.0;
    }
    return look;
}

void VectorLabels::collect(const VisibleTile& visible) {
    const TileGeometry geometry(visible);
    for (const auto& feature : visible.tile->features) {
        if (feature.name >= 0 && scale_.showsNames(feature.kind) && geometry.isVisible(feature)) {
            collectFeature(geometry, feature, visible.tile->names[static_cast<std::size_t>(feature.name)]);
        }
    }
}

void VectorLabels::collectFeature(const TileGeometry& geometry, const tiles::MapTile::Feature& feature, Name name) {
    if (feature.shape == tiles::MapTile::Shape::Lines) {
        if (streetPieces_ >= kMostStreetPieces) {
            return;
        }
        if (isRoad(feature.kind) || feature.kind == tiles::MapKind::WaterLine ||
            feature.kind == tiles::MapKind::WaterName) {
            auto& street = streets_[name];
            street.kind = street.pieces.empty() ? feature.kind : std::max(street.kind, feature.kind);
            geometry.eachLine(feature, [&](const QPolygonF& piece, double /*from*/) {
                if (streetPieces_ < kMostStreetPieces) {
                    street.pieces.push_back(piece);
                    ++streetPieces_;
                }
            });
        }
    } else if (feature.shape == tiles::MapTile::Shape::Areas) {
        if (areas_.size() < kMostAreas &&
            (feature.kind == tiles::MapKind::Water || feature.kind == tiles::MapKind::Park ||
             feature.kind == tiles::MapKind::Square)) {
            auto& path = areas_[{feature.kind, name}];
            path.setFillRule(Qt::WindingFill);
            geometry.addArea(feature, path);
        }
    } else {
        const auto inside = geometry.spots(feature);
        if (!inside.empty()) {
            const auto rank = feature.kind == tiles::MapKind::Place ? static_cast<tiles::PlaceRank>(feature.rank)
                                                                    : tiles::PlaceRank::Hamlet;
            spots_.try_emplace({feature.kind, name}, Spot{feature.kind, rank, inside.front()});
        }
    }
}

void VectorLabels::place(MapLabels& labels) {
    for (const auto& visible : tiles_) {
        collect(visible);
    }
    for (auto& [name, street] : streets_) {
        if (drawing_.stop.stop_requested()) {
            return;
        }
        street.pieces = joinLines(std::move(street.pieces));
        street.length = street.pieces.empty() ? 0.0 : lengthOf(street.pieces.front());
    }
    placePlaces(labels);
    placeStreets(labels, tiles::MapKind::Major);
    placeSpots(labels, tiles::MapKind::WaterName);
    placeAreas(labels, tiles::MapKind::Water);
    placeSpots(labels, tiles::MapKind::ParkName);
    placeAreas(labels, tiles::MapKind::Park);
    placeStreets(labels, tiles::MapKind::Secondary);
    placeStreets(labels, tiles::MapKind::WaterName);
    placeStreets(labels, tiles::MapKind::WaterLine);
    placeStreets(labels, tiles::MapKind::Minor);
    placeSpots(labels, tiles::MapKind::PointOfInterest);
    placeAreas(labels, tiles::MapKind::Square);
    placeStreets(labels, tiles::MapKind::Service);
}

bool VectorLabels::mayTry() {
    return ++tries_ <= kMostTries && !drawing_.stop.stop_requested();
}

void VectorLabels::placePlaces(MapLabels& labels) {
    std::vector<std::pair<Name, const Spot*>> places;
    for (const auto& [key, spot] : spots_) {
        if (spot.kind == tiles::MapKind::Place && scale_.showsPlace(spot.rank)) {
            places.emplace_back(key.second, &spot);
        }
    }
    std::stable_sort(places.begin(), places.end(),
                     [](const auto& a, const auto& b) { return a.second->rank < b.second->rank; });
    for (const auto& [name, spot] : places) {
        const LabelLook look = lookOf(spot->rank);
        for (const double shift : {0.0, -1.2, 1.2}) {
            if (!mayTry() || labels.placeAt(std::string(name), look, spot->point + QPointF(0.0, shift * look.size))) {
                break;
            }
        }
    }
}

void VectorLabels::placeStreets(MapLabels& labels, tiles::MapKind kind) {
    std::vector<std::pair<Name, const Street*>> streets;
    for (const auto& [name, street] : streets_) {
        if (street.kind == kind) {
            streets.emplace_back(name, &street);
        }
    }
    std::stable_sort(streets.begin(), streets.end(),
                     [](const auto& a, const auto& b) { return a.second->length > b.second->length; });
    const LabelLook look = lookOf(kind);
    for (const auto& [name, street] : streets) {
        for (const auto& line : street->pieces) {
            if (!mayTry() || labels.placeAlong(std::string(name), look, line)) {
                break;
            }
        }
    }
}

void VectorLabels::placeAreas(MapLabels& labels, tiles::MapKind kind) {
    const tiles::MapKind spotKind =
        kind == tiles::MapKind::Water ? tiles::MapKind::WaterName : tiles::MapKind::ParkName;
    const LabelLook look = lookOf(kind);
    std::vector<std::pair<double, Name>> areas;
    for (const auto& [key, path] : areas_) {
        const auto isNamed = std::find(named_.begin(), named_.end(), std::pair(spotKind, key.second)) != named_.end();
        if (key.first == kind && !isNamed && !path.isEmpty()) {
            const QRectF visible = path.boundingRect() & labels.room();
            areas.emplace_back(visible.width() * visible.height(), key.second);
        }
    }
    std::stable_sort(areas.begin(), areas.end(), [](const auto& a, const auto& b) { return a.first > b.first; });
    for (const auto& [size, name] : areas) {
        if (!mayTry()) {
            return;
        }
        const QPainterPath& path = areas_[{kind, name}];
        const QRectF bounds = path.boundingRect() & labels.room();
        const QSizeF label = labels.sizeOf(std::string(name), look);
        // A small pond's name would be larger than the pond, and hide what is around it.
        if (label.isEmpty() || bounds.width() < label.width() * 0.7 || bounds.height() < look.size) {
            continue;
        }
        const auto spots = candidates(bounds, centroidOf(path));
        const bool isPlaced =
            std::any_of(spots.begin(), spots.end(), [&, text = std::string(name)](const QPointF& spot) {
                return holds(path, spot, label) && labels.placeAt(text, look, spot);
            });
        if (!isPlaced && kind == tiles::MapKind::Park) {
            labels.placeAt(std::string(name), look, spots.front());
        }
    }
}

void VectorLabels::placeSpots(MapLabels& labels, tiles::MapKind kind) {
    const LabelLook look = lookOf(kind);
    for (const auto& [key, spot] : spots_) {
        if (spot.kind != kind) {
            continue;
        }
        for (const double shift : {0.0, -1.3, 1.3}) {
            if (!mayTry()) {
                return;
            }
            if (labels.placeAt(std::string(key.second), look, spot.point + QPointF(0.0, shift * look.size))) {
                named_.emplace_back(key);
                break;
            }
        }
    }
}

}  // namespace ktr::linux_
