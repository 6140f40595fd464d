#pragma once

#include "platform/map/MapViewport.h"

namespace ktr::platform {

class Geodesy;

/// Degrees from edge to edge.
struct CoordinateSpan {
    double latitudeDelta = 0.0;
    double longitudeDelta = 0.0;
    bool operator==(const CoordinateSpan&) const = default;
};

/// A part of the world around a place. A value; any thread.
struct KTR_API MapRegion {
    Coordinate center;
    CoordinateSpan span;
    bool operator==(const MapRegion&) const = default;

    /// The region that spans these distances (metres) north-south and east-west on the ellipsoid. It ends at the poles;
    /// no span is more than 180 by 360 degrees. A distance that is not greater than 0, or an invalid centre, spans
    /// nothing.
    static MapRegion around(const Coordinate& center, double latitudinalMetres, double longitudinalMetres,
                            const Geodesy& geodesy);
    /// By the installed geodesy; without one the region spans nothing. Main thread.
    static MapRegion around(const Coordinate& center, double latitudinalMetres, double longitudinalMetres);

    /// What a rectangle of this size shows of the world so that the region is in it, its centre in the middle, as large
    /// as can be. No closer than zoom 20, and never beyond the world's edges: near a pole, and where the region is
    /// larger than Mercator's world, the middle gives way first, then the region.
    MapViewport viewport(const Size& size) const;
    /// What a viewport shows.
    static MapRegion of(const MapViewport& viewport);
};

}  // namespace ktr::platform
