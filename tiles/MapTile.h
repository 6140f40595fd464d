#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace ktr::tiles {

/// What a feature of a map is, whatever the schema of the data: in the order of drawing.
enum class MapKind : std::uint8_t {
    BuiltUp,  ///< areas
    Park,
    Water,
    Square,
    Pier,
    Building,
    WaterLine,  ///< lines
    PierLine,
    Path,
    Service,
    Minor,
    Secondary,
    Major,
    Rail,
    Boundary,
    Place,  ///< labels only
    WaterName,
    ParkName,
    BoundaryName,
    PointOfInterest,
};
inline constexpr std::size_t kMapKinds = 20;

/// How important a place is: the first ones are shown from the farthest.
enum class PlaceRank : std::uint8_t { Country, State, Capital, City, Town, Village, Suburb, Neighbourhood, Hamlet };

/// One decoded tile: its features by kind. Coordinates run from 0 to 4096 from the tile's north-west corner; features
/// may reach beyond. A value; once made it is not changed.
struct MapTile {
    static constexpr float kExtent = 4096.0F;

    enum class Shape : std::uint8_t { Points, Lines, Areas };
    struct Spot {
        float x = 0.0F;
        float y = 0.0F;
        bool operator==(const Spot&) const = default;
    };
    struct Feature {
        MapKind kind = MapKind::BuiltUp;
        Shape shape = Shape::Points;
        /// A place's PlaceRank; a boundary's level (2 for a country); a water line's width in metres; else 0.
        std::uint8_t rank = 0;
        bool isNameOnly = false;  ///< there for its name: another feature is what is drawn
        std::int32_t name = -1;   ///< of `names`; -1 for none
        std::uint32_t firstPart = 0;
        std::uint32_t partCount = 0;
        float left = 0.0F, top = 0.0F, right = 0.0F, bottom = 0.0F;  ///< what it covers
    };

    std::vector<Feature> features;  ///< sorted by kind, otherwise in the order of the data
    /// The ends of the parts (points, lines, rings) in `spots`: part i begins where part i − 1 ends.
    std::vector<std::uint32_t> partEnds;
    std::vector<Spot> spots;  ///< rings are not closed: the last spot leads back to the first
    std::vector<std::string> names;

    std::uint32_t partBegin(std::uint32_t part) const { return part == 0 ? 0 : partEnds[part - 1]; }
    /// Roughly what it takes in memory.
    std::size_t bytes() const {
        std::size_t total = sizeof *this + features.size() * sizeof(Feature) + partEnds.size() * sizeof(std::uint32_t) +
                            spots.size() * sizeof(Spot);
        for (const auto& name : names) {
            total += sizeof(std::string) + name.size();
        }
        return total;
    }
};

}  // namespace ktr::tiles
