#include "platform/map/MapRegion.h"

#include <algorithm>
#include <cmath>

#include "platform/base/Platform.h"
#include "platform/location/Geodesy.h"
#include "platform/map/Mercator.h"

namespace ktr::platform {

namespace {

constexpr double kClosestZoom = 20.0;

/// Half of a span of latitudes, degrees: how far the meridian goes in `metres` towards a pole, at most to it.
double latitudesTowards(double pole, const Coordinate& center, double metres, const Geodesy& geodesy) {
    const Coordinate end{pole, center.longitude};
    if (metres >= geodesy.distance(center, end)) {
        return std::abs(pole - center.latitude);
    }
    const Coordinate there = geodesy.destination(center, pole > 0.0 ? 0.0 : 180.0, metres);
    return std::abs(there.latitude - center.latitude);
}

/// Half of a span of longitudes, degrees: how far east the geodesic that leaves eastwards has come.
double longitudesEast(const Coordinate& center, double metres, const Geodesy& geodesy) {
    constexpr double kHalfWay = 20003931.0;  // metres, from a place to the other side of the world
    if (std::abs(center.latitude) >= 90.0 || metres >= kHalfWay) {
        return 180.0;
    }
    const double east = geodesy.destination(center, 90.0, metres).longitude - center.longitude;
    return east < 0.0 ? east + 360.0 : east;
}

/// The zoom at which `part` of the world is `points` wide.
double zoomFor(double part, double points) {
    return part > 0.0 ? std::log2(points / (part * mercatorWorld(0.0))) : kClosestZoom;
}

}  // namespace

MapRegion MapRegion::around(const Coordinate& center, double latitudinalMetres, double longitudinalMetres,
                            const Geodesy& geodesy) {
    MapRegion region{center, {}};
    if (!isValid(center)) {
        return region;
    }
    if (latitudinalMetres > 0.0) {
        const double half = latitudinalMetres / 2.0;
        region.span.latitudeDelta =
            latitudesTowards(90.0, center, half, geodesy) + latitudesTowards(-90.0, center, half, geodesy);
    }
    if (longitudinalMetres > 0.0) {
        region.span.longitudeDelta = std::min(360.0, 2.0 * longitudesEast(center, longitudinalMetres / 2.0, geodesy));
    }
    return region;
}

MapRegion MapRegion::around(const Coordinate& center, double latitudinalMetres, double longitudinalMetres) {
    const auto installed = Platform::installed();
    if (!installed || !installed->geodesy) {
        return {center, {}};
    }
    return around(center, latitudinalMetres, longitudinalMetres, *installed->geodesy);
}

MapViewport MapRegion::viewport(const Size& size) const {
    MapViewport view{center, 0.0, size};
    if (!(size.width > 0.0) || !(size.height > 0.0) || !isValid(center)) {
        return view;
    }
    const double half = std::max(span.latitudeDelta, 0.0) / 2.0;
    const Point middle = mercatorPoint(center);
    const double above = middle.y - mercatorPoint({std::min(center.latitude + half, 90.0), 0.0}).y;
    const double below = mercatorPoint({std::max(center.latitude - half, -90.0), 0.0}).y - middle.y;
    const double wide = std::clamp(span.longitudeDelta, 0.0, 360.0) / 360.0;
    const double fitting = std::min(zoomFor(2.0 * std::max(above, below), size.height), zoomFor(wide, size.width));
    // The whole world is at least as large as the view: there is nothing beyond its edges.
    const double farthest = zoomFor(1.0, std::max(size.width, size.height));
    view.zoom = std::max(std::min(fitting, kClosestZoom), farthest);
    const double reach = size.height / mercatorWorld(view.zoom) / 2.0;
    const double y = std::clamp(middle.y, std::min(reach, 0.5), std::max(1.0 - reach, 0.5));
    if (y != middle.y) {
        view.centre = {mercatorCoordinate({middle.x, y}).latitude, center.longitude};
    }
    return view;
}

MapRegion MapRegion::of(const MapViewport& viewport) {
    const double world = mercatorWorld(viewport.zoom);
    const Point middle = mercatorPoint(viewport.centre);
    const double reach = viewport.size.height / world / 2.0;
    const double north = mercatorCoordinate({0.0, std::max(middle.y - reach, 0.0)}).latitude;
    const double south = mercatorCoordinate({0.0, std::min(middle.y + reach, 1.0)}).latitude;
    return {viewport.centre, {north - south, std::min(viewport.size.width / world, 1.0) * 360.0}};
}

}  // namespace ktr::platform
