#include "linux/maps/MapDrawer.h"

#include <algorithm>
#include <cmath>
#include <exception>

#include "linux/maps/MapStyle.h"
#include "platform/base/LogArea.h"
#include "platform/map/Mercator.h"

namespace ktr::linux_ {

namespace {

/// The longest side of a picture, in points and in pixels: 64 MiB at most.
constexpr double kLongestSide = 4096.0;
constexpr double kHighestZoom = 24.0;

double within(double value, double lowest, double highest, double otherwise) {
    return std::isfinite(value) ? std::clamp(value, lowest, highest) : otherwise;
}

platform::MapPictureRequest checked(platform::MapPictureRequest request) {
    auto& viewport = request.viewport;
    viewport.size.width = within(viewport.size.width, 1.0, kLongestSide, 1.0);
    viewport.size.height = within(viewport.size.height, 1.0, kLongestSide, 1.0);
    viewport.zoom = within(viewport.zoom, 0.0, kHighestZoom, 0.0);
    viewport.centre.latitude =
        within(viewport.centre.latitude, -platform::kLastMercatorLatitude, platform::kLastMercatorLatitude, 0.0);
    viewport.centre.longitude = std::remainder(within(viewport.centre.longitude, -1e6, 1e6, 0.0), 360.0);
    const double longest = std::max(viewport.size.width, viewport.size.height);
    request.scale = std::min(within(request.scale, 0.25, 4.0, 1.0), kLongestSide / longest);
    std::erase_if(request.clear, [](const platform::Rect& rect) {
        return !std::isfinite(rect.x) || !std::isfinite(rect.y) || !std::isfinite(rect.width) ||
               !std::isfinite(rect.height);
    });
    return request;
}

/// Farther out than this nobody looks for streets; metres across.
constexpr double kStreetsAcross = 60000.0;

/// Whether what is left to draw has the picture's middle, where streets would be looked for.
bool isMiddleLeft(const MapDrawing& drawing) {
    const auto& viewport = drawing.request.viewport;
    const double across = std::min(viewport.size.width, viewport.size.height) * viewport.metresPerPoint();
    return across < kStreetsAcross &&
           drawing.region.contains(QPoint(drawing.pixels.width() / 2, drawing.pixels.height() / 2));
}

/// An image of this size; none without memory.
QImage clearImage(const QSize& size) {
    QImage made(size, QImage::Format_ARGB32_Premultiplied);
    if (!made.isNull()) {
        made.fill(Qt::transparent);
    }
    return made;
}

MapDrawn drawGround(MapGround& ground, const MapDrawing& drawing) {
    drawing.painter.save();
    MapDrawn drawn;
    try {
        drawn = ground.draw(drawing);
    } catch (const std::exception& error) {
        platform::areaLog(platform::LogArea::Maps).line("A map cannot be drawn: %@", std::string(error.what()));
    }
    drawing.painter.restore();
    drawn.filled &= drawing.region;
    return drawn;
}

}  // namespace

QImage MapDrawer::Result::whole() const {
    QImage made = pixels;
    QPainter(&made).drawImage(0, 0, labels);
    return made;
}

void MapDrawer::prepare(QPainter& painter, const platform::Size& points) {
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(painter.device()->width() / points.width, painter.device()->height() / points.height);
}

std::optional<MapDrawer::Result> MapDrawer::draw(const platform::MapPictureRequest& asked,
                                                 const std::vector<std::shared_ptr<MapGround>>& grounds,
                                                 const std::stop_token& stop) {
    auto request = checked(asked);
    auto result = drawAt(request, grounds, stop);
    if (result && result->coarseZoom && request.beyond == platform::MapPictureRequest::Beyond::Widen) {
        const double zoom = *result->coarseZoom;
        request.viewport.zoom = zoom;
        request.beyond = platform::MapPictureRequest::Beyond::AsAsked;
        result = drawAt(request, grounds, stop);
        if (result) {
            // Also where a map of streets reaches farther when it is looked at from farther out.
            result->hasStreets = false;
            result->coarseZoom = zoom;
        }
    }
    return result;
}

std::optional<MapDrawer::Result> MapDrawer::drawAt(const platform::MapPictureRequest& request,
                                                   const std::vector<std::shared_ptr<MapGround>>& grounds,
                                                   const std::stop_token& stop) {
    using Beyond = platform::MapPictureRequest::Beyond;
    const auto side = [&](double points) { return std::max(1, static_cast<int>(std::lround(points * request.scale))); };
    Result result;
    result.pixels = QImage(side(request.viewport.size.width), side(request.viewport.size.height), QImage::Format_RGB32);
    if (result.pixels.isNull()) {
        // Out of memory: a picture of one pixel is still one.
        result.pixels = QImage(1, 1, QImage::Format_RGB32);
    }
    const QSize pixels = result.pixels.size();
    result.pixels.fill(MapStyle::of(request.isDark, request.isHighContrast).land);
    result.labels = clearImage(pixels);
    QPainter painter(&result.pixels);
    prepare(painter, request.viewport.size);
    // Without memory for a second picture the names stand under the circles.
    QPainter above;
    if (!result.labels.isNull()) {
        above.begin(&result.labels);
        prepare(above, request.viewport.size);
    }
    MapDrawing drawing{request, painter, above.isActive() ? above : painter, pixels, QRegion(QRect(QPoint(), pixels)),
                       stop};
    for (const auto& ground : grounds) {
        if (drawing.region.isEmpty() || stop.stop_requested()) {
            break;
        }
        if (ground->isCoarse() && result.isComplete && isMiddleLeft(drawing)) {
            result.hasStreets = false;
            result.coarseZoom = request.beyond == Beyond::AsAsked ? std::nullopt : ground->coarseZoom(drawing);
            if (result.coarseZoom && request.beyond == Beyond::Widen) {
                return result;  // drawn anew, farther out
            }
        }
        const MapDrawn drawn = drawGround(*ground, drawing);
        drawing.region -= drawn.filled;
        result.isComplete = result.isComplete && drawn.isComplete;
        if (!drawn.filled.isEmpty() && !drawn.attribution.empty() &&
            result.attribution.find(drawn.attribution) == std::string::npos) {
            result.attribution += (result.attribution.empty() ? "" : " · ") + drawn.attribution;
        }
    }
    if (stop.stop_requested()) {
        return std::nullopt;
    }
    return result;
}

}  // namespace ktr::linux_
