#pragma once

#include <memory>
#include <string>
#include <vector>

#include <QColor>
#include <QPainterPath>
#include <QPolygonF>
#include <QRectF>

#include "linux/maps/LabelShaper.h"
#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

/// How a name is written.
struct LabelLook {
    QColor color;
    QColor halo;
    double size = 12.0;    ///< points
    double spacing = 0.0;  ///< between letters, points; scripts that join their letters get none
    bool isBold = false;
    bool isSlanted = false;
};

/// Places names on a map, the most important ones first: whole, inside the region that is drawn, clear of each other
/// and of what must stay clear. What does not fit is left out. For one picture; any thread.
class MapLabels {
  public:
    /// Names stay inside `drawing.region` and out of the request's clear rectangles.
    MapLabels(const MapDrawing& drawing, LabelShaper& shaper);

    /// In one line around a point. False when it does not fit there.
    bool placeAt(const std::string& name, const LabelLook& look, const QPointF& middle);
    /// Along a line of points, upright, as near to its middle as it fits. False when it fits nowhere.
    bool placeAlong(const std::string& name, const LabelLook& look, const QPolygonF& line);
    /// The size of a name in points, with its halo; empty for a name with nothing to see.
    QSizeF sizeOf(const std::string& name, const LabelLook& look);
    /// The picture, less the margin that names keep to its edge.
    QRectF room() const { return room_; }
    /// All halos, then all letters.
    void draw(QPainter& painter) const;

  private:
    /// A letter's place: where its origin stands, and how it is turned (radians, clockwise).
    struct Stand {
        QPointF origin;
        double angle = 0.0;
    };
    struct Text {
        std::shared_ptr<const LabelGlyphs> glyphs;
        LabelLook look;
        std::vector<double> lefts;  ///< of the letters, points from the label's beginning
        double width = 0.0;
        double rise = 0.0;  ///< from the middle of the line of writing down to the baseline
    };
    struct Placed {
        Text text;
        std::vector<Stand> stands;
    };

    Text text(const std::string& name, const LabelLook& look);
    bool isFree(const QRectF& box) const;
    bool isFree(const std::vector<QRectF>& boxes) const;
    bool tryAlong(const Text& text, const QPolygonF& line, const std::vector<double>& ends, double middle,
                  double mostBend);
    std::vector<Stand> straight(const Text& text, const QPointF& middle, double angle) const;
    std::vector<QRectF> boxes(const Text& text, const std::vector<Stand>& stands) const;
    void put(const Text& text, std::vector<Stand> stands, const std::vector<QRectF>& boxes);
    static QTransform transform(const Text& text, const Stand& stand);

    const MapDrawing& drawing_;
    LabelShaper& shaper_;
    QRectF room_;
    bool isWhole_;  ///< the region is the whole picture
    std::vector<QRectF> taken_;
    std::vector<Placed> placed_;
};

}  // namespace ktr::linux_
