#pragma once

#include <stop_token>

#include <QPainterPath>
#include <QPolygonF>

#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

/// What drawing one picture may cost. The painter's time grows with the square of how often a row of pixels crosses a
/// shape's edges: a file of one tangled line would keep a worker for minutes. What does not fit is not drawn. One
/// thread.
class PaintBudget {
  public:
    explicit PaintBudget(const MapDrawing& drawing);

    /// Whether a surface may be filled; its cost is gone then. Nothing may, once the picture is not wanted any more.
    bool takeArea(const QPainterPath& path);
    /// Whether a line may be drawn this wide; points.
    bool takeLine(const QPolygonF& line, double width);

  private:
    /// A shape: how far all its edges reach from top to bottom together (points), it itself (points), and what it
    /// covers (square points).
    bool take(double edges, double height, double surface);

    double pixels_;  ///< a point
    double left_;    ///< see PaintBudget.cpp
    std::stop_token stop_;
};

}  // namespace ktr::linux_
