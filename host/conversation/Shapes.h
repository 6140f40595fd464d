#pragma once

#include <QPainterPath>
#include <QRectF>

#include "linux/paint/QtCanvas.h"
#include "platform/base/Geometry.h"
#include "platform/ui/Canvas.h"

namespace ktr::host {

/// What a host paints beyond the rectangles that views know: through the painter behind the canvas. A canvas of another
/// kind (a recording one in a test) shows no shapes.
linux_::QtCanvas* qtCanvas(platform::Canvas& canvas);

QRectF toQt(const platform::Rect& rect);
/// A rectangle with all corners round, or with one corner of its own: the bottom end one of a bubble.
QPainterPath roundedPath(const QRectF& rect, double corner);
QPainterPath bubblePath(const QRectF& rect, double corner, double tailCorner, bool rightToLeft);
void fillPath(linux_::QtCanvas& canvas, const QPainterPath& path, const QColor& color);
/// Draws an edge wholly inside a rounded rectangle.
void strokeInside(linux_::QtCanvas& canvas, const QRectF& rect, double corner, const QColor& color, double width);

/// The colour of a text that the host has of its own.
platform::Color textColor(const QColor& color);

/// A rectangle as its mirror image has it in a parent of this width.
platform::Rect mirrored(const platform::Rect& rect, double parentWidth, bool rightToLeft);

}  // namespace ktr::host
