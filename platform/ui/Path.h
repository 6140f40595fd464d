#pragma once

#include <vector>

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"

namespace ktr::platform {

/// An outline of lines and curves, in points. A value; any thread.
class KTR_API Path {
  public:
    enum class Verb { Move, Line, Quad, Cubic, Close };
    struct Element {
        Verb verb = Verb::Move;
        /// Of a quadratic curve the first alone; of lines and moves neither.
        Point control1;
        Point control2;
        Point end;
        bool operator==(const Element&) const = default;
    };

    void moveTo(Point end) { elements_.push_back({Verb::Move, {}, {}, end}); }
    void lineTo(Point end) { elements_.push_back({Verb::Line, {}, {}, end}); }
    void quadTo(Point control, Point end) { elements_.push_back({Verb::Quad, control, {}, end}); }
    void cubicTo(Point control1, Point control2, Point end) {
        elements_.push_back({Verb::Cubic, control1, control2, end});
    }
    void close() { elements_.push_back({Verb::Close, {}, {}, {}}); }

    /// An arc of a circle. Angles in degrees, clockwise from three o'clock (y grows downwards); a negative sweep turns
    /// the other way. A path under way is continued with a line to the arc's start.
    void addArc(Point centre, double radius, double startDegrees, double sweepDegrees);
    /// A closed ellipse that fills the rectangle.
    void addEllipse(const Rect& rect);
    void addCircle(Point centre, double radius);
    /// Corners of at most half the shorter side.
    void addRoundedRect(const Rect& rect, double radius);

    const std::vector<Element>& elements() const { return elements_; }
    bool empty() const { return elements_.empty(); }
    Path translated(double dx, double dy) const;
    /// A rectangle that holds all points, control points included; zero when empty.
    Rect controlBounds() const;
    bool operator==(const Path&) const = default;

  private:
    void addArc(Point centre, double radiusX, double radiusY, double startDegrees, double sweepDegrees);

    std::vector<Element> elements_;
};

/// How an outline is drawn; corners are round.
struct Stroke {
    double width = 1.0;  ///< points
    bool roundEnds = false;
    bool operator==(const Stroke&) const = default;
};

}  // namespace ktr::platform
