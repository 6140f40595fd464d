#pragma once

#include "tiles/MapTile.h"

namespace ktr::linux_ {

/// How wide things are drawn, and what is drawn at all, at one scale of the map. A value; any thread.
class MapScale {
  public:
    /// Points; a fill of 0 is not drawn, a casing of 0 neither.
    struct Width {
        double fill = 0.0;
        double casing = 0.0;
    };

    /// Ground metres a point, positive.
    explicit MapScale(double metresPerPoint) : metres_(metresPerPoint) {}

    double metresPerPoint() const { return metres_; }
    /// Of a class of road (Service, Minor, Secondary, Major) or path; nothing for other kinds.
    Width road(tiles::MapKind kind) const;
    /// Of a river, canal or stream of this width in metres; 0 when it is too small to be seen.
    double waterLine(double metres) const;
    /// The share of its full width that a rail, pier line or boundary has.
    double lineFactor() const;
    bool showsBuildings() const { return metres_ <= 4.0; }
    /// Whether streets of this class, or labels of this kind, have their names.
    bool showsNames(tiles::MapKind kind) const;
    /// Whether a place of this rank is shown: neither from too far nor from so near that it fills the map.
    bool showsPlace(tiles::PlaceRank rank) const;
    /// What the sizes of labels are multiplied with.
    double labelFactor() const;

  private:
    double metres_;
};

}  // namespace ktr::linux_
