#pragma once

namespace ktr::platform {

/// Points; y grows downwards.
struct Point {
    double x = 0.0;
    double y = 0.0;
    bool operator==(const Point&) const = default;
};

/// Points.
struct Size {
    double width = 0.0;
    double height = 0.0;
    bool operator==(const Size&) const = default;
};

/// Points, in the coordinates of the superview unless said otherwise.
struct Rect {
    double x = 0.0;
    double y = 0.0;
    double width = 0.0;
    double height = 0.0;

    double maxX() const { return x + width; }
    double maxY() const { return y + height; }
    Size size() const { return {width, height}; }
    Point origin() const { return {x, y}; }
    bool contains(Point p) const { return p.x >= x && p.x < maxX() && p.y >= y && p.y < maxY(); }
    bool intersects(const Rect& o) const { return x < o.maxX() && o.x < maxX() && y < o.maxY() && o.y < maxY(); }
    Rect offsetBy(double dx, double dy) const { return {x + dx, y + dy, width, height}; }
    bool operator==(const Rect&) const = default;
};

/// Points.
struct EdgeInsets {
    double top = 0.0;
    double left = 0.0;
    double bottom = 0.0;
    double right = 0.0;
    bool operator==(const EdgeInsets&) const = default;
};

}  // namespace ktr::platform
