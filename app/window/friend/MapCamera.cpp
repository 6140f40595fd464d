#include "app/window/friend/MapCamera.h"

#include <algorithm>
#include <cmath>

#include "platform/map/Mercator.h"

namespace ktr::app {

using platform::Coordinate;
using platform::MapViewport;
using platform::Point;

double MapCamera::zoomFor(const Coordinate& coordinate, double metresPerPoint) {
    const double atZero = MapViewport{coordinate, 0.0, {}}.metresPerPoint();
    return std::clamp(std::log2(atZero / metresPerPoint), kCoarsest, kFinest);
}

MapViewport MapCamera::viewport(const Coordinate& coordinate, const Point& at, double zoom,
                                const platform::Size& size) {
    const double clamped = std::clamp(zoom, kCoarsest, kFinest);
    const double world = platform::mercatorWorld(clamped);
    const Point place = platform::mercatorPoint(coordinate);
    // Neither pole is crossed: beyond them there is no ground.
    const double y = std::clamp(place.y + (size.height / 2.0 - at.y) / world, 0.0, 1.0);
    return {platform::mercatorCoordinate({place.x + (size.width / 2.0 - at.x) / world, y}), clamped, size};
}

void MapCamera::put(const Coordinate& coordinate, const Point& at, double zoom) {
    stop();
    shown_ = viewport(coordinate, at, zoom, shown_.size);
}

void MapCamera::flyTo(const Coordinate& coordinate, const Point& at, double zoom, double now, double seconds) {
    flight_ =
        Flight{shown_, viewport(coordinate, at, zoom, shown_.size), std::nullopt, host::Motion(0.0, 1.0, now, seconds)};
}

void MapCamera::panBy(double dx, double dy) {
    stop();
    const Point middle{shown_.size.width / 2.0, shown_.size.height / 2.0};
    shown_ = viewport(shown_.centre, {middle.x + dx, middle.y + dy}, shown_.zoom, shown_.size);
}

void MapCamera::zoomBy(double steps, const Point& at) {
    stop();
    shown_ = viewport(shown_.coordinateAt(at), at, shown_.zoom + steps, shown_.size);
}

void MapCamera::zoomOn(double steps, const Point& at, double now, double seconds) {
    const double to = target().zoom + steps;
    const Coordinate place = shown_.coordinateAt(at);
    flight_ = Flight{shown_, viewport(place, at, to, shown_.size), at, host::Motion(0.0, 1.0, now, seconds)};
}

bool MapCamera::advance(double now) {
    if (!flight_) {
        return false;
    }
    const Flight flight = *flight_;
    const double share = flight.share.at(now);
    if (flight.share.isOver(now)) {
        shown_ = flight.to;
        flight_.reset();
        return false;
    }
    const double zoom = flight.from.zoom + (flight.to.zoom - flight.from.zoom) * share;
    if (flight.fixed) {
        shown_ = viewport(flight.from.coordinateAt(*flight.fixed), *flight.fixed, zoom, shown_.size);
    } else {
        const Point a = platform::mercatorPoint(flight.from.centre);
        const Point b = platform::mercatorPoint(flight.to.centre);
        const double dx = b.x - a.x;
        shown_ = {platform::mercatorCoordinate({a.x + (dx - std::round(dx)) * share, a.y + (b.y - a.y) * share}), zoom,
                  shown_.size};
    }
    return true;
}

}  // namespace ktr::app
