#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "tiles/MapTile.h"

namespace ktr::server {

/// The named streets of one tile, in a grid of cells, so that the nearest to a spot is found without a look at all of
/// them. Units are those of the tile (`tiles::MapTile::kExtent` a side). A value; once made it is not changed.
class StreetGrid {
  public:
    // A tile that holds more than this is cut there: no honest one does.
    static constexpr std::size_t kMostSegments = 200'000;
    static constexpr std::size_t kMostEntries = 1'000'000;

    struct Nearest {
        std::string_view name;  ///< as long as the grid lives
        double distance = 0.0;
    };

    StreetGrid() = default;
    explicit StreetGrid(const tiles::MapTile& tile);

    /// The street nearest to a spot, which may lie beside the tile; none where there is none within `reach`.
    std::optional<Nearest> nearest(double x, double y, double reach) const;
    std::size_t bytes() const;

  private:
    static constexpr int kSide = 16;  ///< cells
    static constexpr std::size_t kCells = std::size_t{kSide} * kSide;

    struct Segment {
        std::int16_t fromX = 0, fromY = 0, toX = 0, toY = 0;
        std::uint32_t name = 0;
    };

    static int cellOf(double coordinate);
    static double distance(const Segment& segment, double x, double y);
    void addFeature(const tiles::MapTile& tile, const tiles::MapTile::Feature& feature, std::uint32_t name);
    void sortIntoCells();

    std::vector<Segment> segments_;
    std::vector<std::string> names_;
    /// Where the entries of each cell end; those of a cell begin where those of the one before end.
    std::vector<std::uint32_t> ends_;
    std::vector<std::uint32_t> entries_;  ///< segments, by cell
};

}  // namespace ktr::server
