#include "platform/ui/Path.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace ktr::platform {

void Path::addArc(Point centre, double radius, double startDegrees, double sweepDegrees) {
    addArc(centre, radius, radius, startDegrees, sweepDegrees);
}

void Path::addArc(Point centre, double radiusX, double radiusY, double startDegrees, double sweepDegrees) {
    const double sweep = std::clamp(sweepDegrees, -360.0, 360.0) * std::numbers::pi / 180.0;
    double angle = startDegrees * std::numbers::pi / 180.0;
    const auto at = [&](double a) { return Point{centre.x + radiusX * std::cos(a), centre.y + radiusY * std::sin(a)}; };
    const bool continues = !elements_.empty() && elements_.back().verb != Verb::Close;
    continues ? lineTo(at(angle)) : moveTo(at(angle));
    // A cubic curve comes within 0.03 % of a quarter of a circle.
    const int pieces = std::max(1, static_cast<int>(std::ceil(std::abs(sweep) / (std::numbers::pi / 2.0) - 1e-9)));
    const double step = sweep / pieces;
    const double reach = 4.0 / 3.0 * std::tan(step / 4.0);
    for (int i = 0; i < pieces; ++i, angle += step) {
        const Point from = at(angle);
        const Point to = at(angle + step);
        const Point out{from.x - reach * radiusX * std::sin(angle), from.y + reach * radiusY * std::cos(angle)};
        const Point in{to.x + reach * radiusX * std::sin(angle + step),
                       to.y - reach * radiusY * std::cos(angle + step)};
        cubicTo(out, in, to);
    }
}

void Path::addEllipse(const Rect& rect) {
    moveTo({rect.maxX(), rect.y + rect.height / 2.0});
    addArc({rect.x + rect.width / 2.0, rect.y + rect.height / 2.0}, rect.width / 2.0, rect.height / 2.0, 0.0, 360.0);
    close();
}

void Path::addCircle(Point centre, double radius) {
    addEllipse({centre.x - radius, centre.y - radius, 2.0 * radius, 2.0 * radius});
}

void Path::addRoundedRect(const Rect& rect, double radius) {
    const double r = std::max(0.0, std::min(radius, std::min(rect.width, rect.height) / 2.0));
    moveTo({rect.x + r, rect.y});
    addArc({rect.maxX() - r, rect.y + r}, r, -90.0, 90.0);
    addArc({rect.maxX() - r, rect.maxY() - r}, r, 0.0, 90.0);
    addArc({rect.x + r, rect.maxY() - r}, r, 90.0, 90.0);
    addArc({rect.x + r, rect.y + r}, r, 180.0, 90.0);
    close();
}

Path Path::translated(double dx, double dy) const {
    Path moved = *this;
    for (Element& element : moved.elements_) {
        for (Point* point : {&element.control1, &element.control2, &element.end}) {
            *point = {point->x + dx, point->y + dy};
        }
    }
    return moved;
}

Rect Path::controlBounds() const {
    bool any = false;
    double left = 0.0;
    double top = 0.0;
    double right = 0.0;
    double bottom = 0.0;
    const auto include = [&](Point p) {
        left = any ? std::min(left, p.x) : p.x;
        right = any ? std::max(right, p.x) : p.x;
        top = any ? std::min(top, p.y) : p.y;
        bottom = any ? std::max(bottom, p.y) : p.y;
        any = true;
    };
    for (const Element& element : elements_) {
        if (element.verb == Verb::Close) {
            continue;
        }
        if (element.verb == Verb::Quad || element.verb == Verb::Cubic) {
            include(element.control1);
        }
        if (element.verb == Verb::Cubic) {
            include(element.control2);
        }
        include(element.end);
    }
    return {left, top, right - left, bottom - top};
}

}  // namespace ktr::platform
