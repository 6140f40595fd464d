#include "linux/maps/VectorGround.h"
#include "linux/maps/MbtilesLoader.h"

#include <algorithm>
#include <cmath>
#include <string_view>
#include <system_error>
#include <utility>

#include "linux/maps/MapLabels.h"
#include "linux/maps/MapScale.h"
#include "linux/maps/MapStyle.h"
#include "linux/maps/VectorLabels.h"
#include "linux/maps/VectorPainter.h"
#include "platform/base/LogArea.h"
#include "tiles/Gunzip.h"
#include "tiles/VectorTileDecoder.h"

namespace ktr::linux_ {

namespace {

/// A file that cannot be read is tried again after this.
constexpr auto kRetry = std::chrono::seconds(5);
/// The smallest side of a tile; points. Tiles come out up to twice as large.
constexpr double kTilePoints = 256.0;
/// A map farther away than this from the coarsest tiles is left to others; levels.
constexpr double kMostLevelsAway = 2.0;
/// What is drawn beyond the picture's edge, so that wide lines and their ends are whole; points.
constexpr double kMargin = 24.0;

}  // namespace

VectorGround::VectorGround(std::string path) : path_(std::move(path)) {}

bool VectorGround::open() {
    std::error_code failed;
    const auto written = std::filesystem::last_write_time(path_, failed);
    const auto now = std::chrono::steady_clock::now();
    if (opened_ && !failed && written == written_ && (file_ || now - *opened_ < kRetry)) {
        return file_ != nullptr;
    }
    opened_ = now;
    written_ = written;
    cache_.clear();
    std::string error;
    file_ = MbtilesLoader::open(path_, error);
    if (file_) {
        facts_ = tiles::TilesetFacts::of(file_->metadata());
        const auto coarsest = facts_.coarsest ? facts_.coarsest : file_->coarsestLevel();
        const auto finest = facts_.finest ? facts_.finest : file_->finestLevel();
        if (!facts_.format.empty() && facts_.format != "pbf" && facts_.format != "mvt") {
            file_.reset();  // pictures: another ground's
        } else if (!coarsest || !finest || *coarsest > *finest) {
            error = "no tiles";
            file_.reset();
        } else {
            coarsest_ = *coarsest;
            finest_ = *finest;
        }
    }
    if (!error.empty() && error != reported_) {
        platform::areaLog(platform::LogArea::Maps)
            .write(platform::LogLevel::Error, "The map %@ cannot be read: %@", platform::FormatArgument(path_).shown(),
                   platform::FormatArgument(error).shown());
    }
    reported_ = error;
    return file_ != nullptr;
}

std::shared_ptr<const tiles::MapTile> VectorGround::read(const tiles::TileKey& key, const std::string& language) {
    if (language != language_) {
        cache_.clear();
        language_ = language;
    }
    if (const auto known = cache_.find(key)) {
        return *known;
    }
    std::shared_ptr<const tiles::MapTile> tile;
    if (const auto stored = file_->tile(key)) {
        const auto unpacked = tiles::gunzip({reinterpret_cast<const char*>(stored->data()), stored->size()},
                                            tiles::VectorTileDecoder::kLargestTile);
        if (unpacked) {
            tile = tiles::VectorTileDecoder(language).decode(
                {reinterpret_cast<const char*>(unpacked->data()), unpacked->size()});
        }
    }
    cache_.put(key, tile);
    return tile;
}

std::optional<VectorGround::Found> VectorGround::find(const tiles::TileKey& key, const std::string& language) {
    for (int level = key.z; level >= coarsest_; --level) {
        const tiles::TileKey parent = key.parent(level);
        if (auto tile = read(parent, language)) {
            return Found{std::move(tile), parent};
        }
    }
    return std::nullopt;
}

/// None for a coarser tile with nothing to show here: a file of one town says nothing about the rest of the world.
std::optional<VisibleTile> VectorGround::place(const PlacedTile& placed, const Found& found,
                                               const QRectF& shown) const {
    const double parts = std::exp2(placed.key.z - found.key.z);
    VisibleTile visible;
    visible.tile = found.tile;
    const double side = placed.points.width() * parts;
    visible.square =
        QRectF(placed.points.x() - (placed.key.x - found.key.x * parts) * placed.points.width(),
               placed.points.y() - (placed.key.y - found.key.y * parts) * placed.points.height(), side, side);
    visible.window = placed.points & shown;
    if (parts > 1.0) {
        VisibleTile whole = visible;
        // What only touches the edge is a neighbour's.
        whole.window = placed.points.adjusted(0.5, 0.5, -0.5, -0.5);
        const TileGeometry geometry(whole);
        const auto& features = found.tile->features;
        if (std::none_of(features.begin(), features.end(),
                         [&](const auto& feature) { return geometry.isVisible(feature); })) {
            return std::nullopt;
        }
    }
    return visible;
}

/// The pixels of a tile that lie in what the file says it covers.
QRegion VectorGround::covered(const PlacedTile& placed) const {
    if (!facts_.bounds) {
        return QRegion(placed.pixels);
    }
    const double count = std::exp2(placed.key.z);
    const auto share = [&](double world, int index) { return std::clamp(world * count - index, 0.0, 1.0); };
    const QRectF pixels(placed.pixels);
    const double left = std::round(pixels.x() + share(facts_.bounds->left, placed.key.x) * pixels.width());
    const double right = std::round(pixels.x() + share(facts_.bounds->right, placed.key.x) * pixels.width());
    const double top = std::round(pixels.y() + share(facts_.bounds->top, placed.key.y) * pixels.height());
    const double bottom = std::round(pixels.y() + share(facts_.bounds->bottom, placed.key.y) * pixels.height());
    return QRegion(QRectF(left, top, right - left, bottom - top).toRect());
}

MapDrawn VectorGround::draw(const MapDrawing& drawing) {
    if (!open()) {
        return {};
    }
    const auto& request = drawing.request;
    const int level = MapTiles::level(request.viewport, kTilePoints, coarsest_, finest_);
    if (level - request.viewport.zoom > kMostLevelsAway) {
        return {};
    }
    const QRectF shown = QRectF(0.0, 0.0, request.viewport.size.width, request.viewport.size.height)
                             .adjusted(-kMargin, -kMargin, kMargin, kMargin);
    std::vector<VisibleTile> tiles;
    QRegion filled;
    for (const auto& placed : MapTiles::of(drawing, level)) {
        if (drawing.stop.stop_requested()) {
            return {};
        }
        const QRegion part = covered(placed) & drawing.region;
        if (part.isEmpty()) {
            continue;
        }
        const auto found = find(placed.key, request.language);
        auto visible = found ? place(placed, *found, shown) : std::nullopt;
        if (visible) {
            tiles.push_back(std::move(*visible));
            filled += part;
        }
    }
    if (filled.isEmpty()) {
        return {};
    }
    QPainter& painter = drawing.painter;
    const QTransform points = painter.transform();
    painter.resetTransform();
    painter.setClipRegion(filled);
    painter.fillRect(QRect(QPoint(), drawing.pixels), MapStyle::of(request.isDark, request.isHighContrast).land);
    painter.setTransform(points);
    const MapDrawing own{request, painter, drawing.labels, drawing.pixels, filled, drawing.stop};
    const MapScale scale(request.viewport.metresPerPoint());
    VectorPainter(own, tiles, scale).draw();
    MapLabels labels(own, shaper_);
    VectorLabels(own, tiles, scale).place(labels);
    labels.draw(drawing.labels);
    return {filled, facts_.attribution, true};
}

}  // namespace ktr::linux_
