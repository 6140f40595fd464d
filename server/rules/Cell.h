#pragma once

#include <cstdint>

namespace ktr::server {

/// A cell of the one grid over the earth on which coarse places lie: the same for everybody and for ever, so that many
/// looks tell no more than one. A value.
struct Cell {
    std::int64_t row = 0;
    std::int64_t column = 0;

    struct Place {
        double latitude = 0.0;  ///< of the centre
        double longitude = 0.0;
        double radius = 0.0;  ///< metres, to a corner: the whole cell is within
    };

    /// The cell of a place, on the grid whose cells have this side in metres (from 100 to 100,000). Rows have one
    /// height; a row has as many cells as fit along its parallel nearest to the equator, so that none is narrower than
    /// its side there.
    static Cell of(double latitude, double longitude, double side);
    Place place(double side) const;

    bool operator==(const Cell&) const = default;
};

}  // namespace ktr::server
