#include "linux/maps/PictureGround.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

#include "linux/maps/MapStyle.h"
#include "linux/paint/ImageDecoder.h"

namespace ktr::linux_ {

namespace {

/// Tiles are drawn between 1/√2 and √2 times this large at scale 1; points.
constexpr double kTilePoints = 256.0;
/// A map farther away than this from the coarsest tiles is left to others; levels.
constexpr double kMostLevelsAway = 2.0;

constexpr double kSaturation = 0.6;
constexpr std::array<double, 3> kTone = {0xE8 / 255.0, 0xDF / 255.0, 0xD2 / 255.0};
/// What each colour has in the brightness of a pixel (Rec. 709).
constexpr std::array<double, 3> kBrightness = {0.2126, 0.7152, 0.0722};

int toneOf(double value, double tone) {
    return static_cast<int>(std::lround(std::clamp(value, 0.0, 255.0) * tone));
}

/// What shows through a picture is land.
QImage onLand(const QImage& picture) {
    QImage whole(picture.size(), QImage::Format_RGB32);
    if (whole.isNull()) {
        return {};
    }
    whole.fill(MapStyle::of(false, false).land);
    QPainter painter(&whole);
    painter.drawImage(QRect(QPoint(), picture.size()), picture);
    return whole;
}

}  // namespace

void PictureGround::darken(QImage& pixels) {
    pixels.convertTo(QImage::Format_RGB32);
    for (int y = 0; y < pixels.height(); ++y) {
        auto* line = reinterpret_cast<QRgb*>(pixels.scanLine(y));
        for (int x = 0; x < pixels.width(); ++x) {
            const std::array<int, 3> colors = {qRed(line[x]), qGreen(line[x]), qBlue(line[x])};
            const auto [least, most] = std::minmax({colors[0], colors[1], colors[2]});
            // The lightness of a colour is the middle of its least and most; moving all three alike keeps the hue.
            const int shift = 255 - least - most;
            double gray = 0.0;
            for (std::size_t i = 0; i < 3; ++i) {
                gray += kBrightness[i] * (colors[i] + shift);
            }
            const auto paler = [&](std::size_t i) {
                return toneOf(gray + kSaturation * (colors[i] + shift - gray), kTone[i]);
            };
            line[x] = qRgb(paler(0), paler(1), paler(2));
        }
    }
}

QImage PictureGround::read(const tiles::TileKey& key, bool isDark, bool isWanted, bool& isComing) {
    const TilePictures::Answer answer = pictures_->tile(key, isWanted);
    isComing = isComing || answer.isComing;
    const auto known = std::find_if(kept_.begin(), kept_.end(),
                                    [&](const Kept& kept) { return kept.key == key && kept.isDark == isDark; });
    if (known != kept_.end()) {
        if (known->version == answer.version) {
            kept_.splice(kept_.begin(), kept_, known);
            return kept_.front().pixels;
        }
        keptBytes_ -= static_cast<std::size_t>(known->pixels.sizeInBytes());
        kept_.erase(known);
    }
    if (!answer.data) {
        return {};
    }
    QImage pixels;
    if (auto picture = ImageDecoder::decode(*answer.data, kLargestSide)) {
        pixels = std::move(picture->pixels);
        if (pixels.hasAlphaChannel()) {
            pixels = onLand(pixels);
        }
        if (isDark) {
            darken(pixels);
        } else {
            pixels.convertTo(QImage::Format_RGB32);
        }
    }
    kept_.push_front({key, isDark, answer.version, pixels});
    keptBytes_ += static_cast<std::size_t>(pixels.sizeInBytes());
    while (keptBytes_ > kMostBytes && kept_.size() > 1) {
        keptBytes_ -= static_cast<std::size_t>(kept_.back().pixels.sizeInBytes());
        kept_.pop_back();
    }
    return pixels;
}

std::optional<PictureGround::Found> PictureGround::find(const tiles::TileKey& key, bool isDark, bool& isComing) {
    for (int level = key.z; level >= pictures_->coarsest(); --level) {
        const tiles::TileKey parent = key.parent(level);
        // A coarser tile is fetched only where there is no finer one.
        const QImage pixels = read(parent, isDark, !isComing, isComing);
        if (!pixels.isNull()) {
            const double parts = std::exp2(key.z - level);
            const double width = pixels.width() / parts;
            const double height = pixels.height() / parts;
            return Found{
                pixels, QRectF((key.x - parent.x * parts) * width, (key.y - parent.y * parts) * height, width, height)};
        }
    }
    return std::nullopt;
}

QRegion PictureGround::covered(const PlacedTile& placed) const {
    const auto bounds = pictures_->bounds();
    if (!bounds) {
        return QRegion(placed.pixels);
    }
    const double count = std::exp2(placed.key.z);
    const auto share = [&](double world, int index) { return std::clamp(world * count - index, 0.0, 1.0); };
    const QRectF pixels(placed.pixels);
    const double left = std::round(pixels.x() + share(bounds->left, placed.key.x) * pixels.width());
    const double right = std::round(pixels.x() + share(bounds->right, placed.key.x) * pixels.width());
    const double top = std::round(pixels.y() + share(bounds->top, placed.key.y) * pixels.height());
    const double bottom = std::round(pixels.y() + share(bounds->bottom, placed.key.y) * pixels.height());
    return QRegion(QRectF(left, top, right - left, bottom - top).toRect());
}

MapDrawn PictureGround::draw(const MapDrawing& drawing) {
    if (!pictures_->open()) {
        return {};
    }
    const auto& viewport = drawing.request.viewport;
    // Finer tiles for finer pixels, but not so fine that their writing cannot be read.
    const double points = kTilePoints / std::numbers::sqrt2 / std::sqrt(std::max(1.0, drawing.request.scale));
    const int level = MapTiles::level(viewport, points, pictures_->coarsest(), pictures_->finest());
    if (level - viewport.zoom > kMostLevelsAway) {
        return {};
    }
    MapDrawn drawn;
    QPainter& painter = drawing.painter;
    painter.resetTransform();
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    for (const PlacedTile& placed : MapTiles::of(drawing, level)) {
        if (drawing.stop.stop_requested()) {
            return {};
        }
        const QRegion part = covered(placed) & drawing.region;
        if (part.isEmpty()) {
            continue;
        }
        bool isComing = false;
        const auto found = find(placed.key, drawing.request.isDark, isComing);
        drawn.isComplete = drawn.isComplete && !isComing;
        if (found) {
            painter.setClipRegion(part);
            painter.drawImage(QRectF(placed.pixels), found->pixels, found->part);
            drawn.filled += part;
        }
    }
    drawn.attribution = pictures_->attribution();
    return drawn;
}

}  // namespace ktr::linux_
