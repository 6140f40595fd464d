#include "host/conversation/Shapes.h"

#include <QPainter>
#include <algorithm>

namespace ktr::host {

linux_::QtCanvas* qtCanvas(platform::Canvas& canvas) {
    return dynamic_cast<linux_::QtCanvas*>(&canvas);
}

QRectF toQt(const platform::Rect& rect) {
    return {rect.x, rect.y, rect.width, rect.height};
}

QPainterPath roundedPath(const QRectF& rect, double corner) {
    const double radius = std::clamp(corner, 0.0, std::min(rect.width(), rect.height()) / 2.0);
    QPainterPath path;
    path.addRoundedRect(rect, radius, radius);
    return path;
}

QPainterPath bubblePath(const QRectF& rect, double corner, double tailCorner, bool rightToLeft) {
    const double most = std::min(rect.width(), rect.height()) / 2.0;
    const double r = std::min(corner, most);
    const double right = rightToLeft ? r : std::min(tailCorner, most);
    const double left = rightToLeft ? std::min(tailCorner, most) : r;
    QPainterPath path;
    path.moveTo(rect.left() + r, rect.top());
    path.arcTo(rect.right() - 2 * r, rect.top(), 2 * r, 2 * r, 90, -90);
    path.arcTo(rect.right() - 2 * right, rect.bottom() - 2 * right, 2 * right, 2 * right, 0, -90);
    path.arcTo(rect.left(), rect.bottom() - 2 * left, 2 * left, 2 * left, 270, -90);
    path.arcTo(rect.left(), rect.top(), 2 * r, 2 * r, 180, -90);
    path.closeSubpath();
    return path;
}

void fillPath(linux_::QtCanvas& canvas, const QPainterPath& path, const QColor& color) {
    canvas.painter().fillPath(path, color);
}

void strokeInside(linux_::QtCanvas& canvas, const QRectF& rect, double corner, const QColor& color, double width) {
    if (width <= 0.0) {
        return;
    }
    const double half = width / 2.0;
    canvas.painter().strokePath(roundedPath(rect.adjusted(half, half, -half, -half), corner - half),
                                QPen(color, width));
}

platform::Color textColor(const QColor& color) {
    return platform::Color::rgb(color.redF(), color.greenF(), color.blueF());
}

platform::Rect mirrored(const platform::Rect& rect, double parentWidth, bool rightToLeft) {
    return rightToLeft ? platform::Rect{parentWidth - rect.maxX(), rect.y, rect.width, rect.height} : rect;
}

}  // namespace ktr::host
