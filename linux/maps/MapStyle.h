#pragma once

#include <QColor>

namespace ktr::linux_ {

/// The colours of a map's ground for one appearance. A value; any thread.
class MapStyle {
  public:
    static const MapStyle& of(bool isDark, bool isHighContrast);

    bool isDark = false;

    QColor land, builtUp;
    QColor water, shore;
    QColor park, parkEdge;
    QColor square, pier;
    QColor building, buildingEdge;
    QColor major, majorCasing;
    QColor secondary, secondaryCasing;
    QColor minor, minorCasing;
    QColor path;
    QColor rail, railInner;
    QColor boundary;  ///< with its alpha
    QColor label, halo;
    QColor town;        ///< the middle of its mark; the edge is `label`
    QColor waterLabel;  ///< its halo is the water
    QColor parkLabel;   ///< its halo is `halo`
    QColor boundaryLabel, pointOfInterest;

    // Points.
    static constexpr double kShoreWidth = 1.2;
    static constexpr double kParkEdgeWidth = 0.8;
    static constexpr double kBuildingEdgeWidth = 0.7;
    static constexpr double kRailWidth = 2.6;
    static constexpr double kRailInnerWidth = 1.4;
    static constexpr double kBoundaryWidth = 1.1;
    static constexpr double kHaloWidth = 2.8;
};

}  // namespace ktr::linux_
