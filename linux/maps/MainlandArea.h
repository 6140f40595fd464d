#pragma once

#include "linux/maps/WorldMap.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::linux_ {

/// Where maps are made in the datum GCJ-02: mainland China, without Hong Kong, Macau and Taiwan. A value; any thread.
///
/// The rule, with the border as the built-in world has it, which is true to about a kilometre:
/// - inside the border;
/// - up to kBorderMetres beyond a border on land, since towns reach right up to it, and its own maps beyond it; but
///   not where it runs through a city (Hong Kong, Macau);
/// - at sea up to kSeaMetres off a coast, for the islands and piers that the data leaves out, unless a land border or
///   somebody else's shore is nearer.
class MainlandArea {
  public:
    static constexpr double kBorderMetres = 1000.0;
    /// Twelve nautical miles, the territorial sea.
    static constexpr double kSeaMetres = 22224.0;

    explicit MainlandArea(WorldMap::Outline outline);

    /// False for an invalid coordinate.
    bool contains(const platform::Coordinate& coordinate) const;

  private:
    bool isInside(QPointF place) const;

    WorldMap::Outline outline_;
    QRectF bounds_;  ///< with the sea
};

}  // namespace ktr::linux_
