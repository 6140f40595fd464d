#include "linux/paint/QtCanvas.h"

#include <QPaintEngine>
#include <QPainter>
#include <QPainterPath>
#include <QPen>
#include <QTransform>
#include <algorithm>
#include <cmath>

#include "linux/paint/QtImage.h"
#include "linux/paint/QtTextImage.h"
#include "linux/paint/QtTextLayout.h"

namespace ktr::linux_ {

namespace {

/// Thinner than this is a line: one pixel, wherever it falls.
constexpr double kLine = 1.5;
/// Frames are sums of many terms: what is meant to be a half must not fall to either side by its last bits.
constexpr double kSlack = 1e-6;

struct Stretch {
    double from = 0.0;
    double to = 0.0;
};

/// In device pixels.
Stretch snap(double from, double extent) {
    const double start = std::floor(from + 0.5 + kSlack);
    if (extent <= 0.0) {
        return {start, start};
    }
    if (extent < kLine) {
        return {start, start + 1.0};
    }
    return {start, std::max(start + 1.0, std::floor(from + extent + 0.5 + kSlack))};
}

}  // namespace

QtCanvas::QtCanvas(QPainter& painter, const Palette& palette, double pixelsPerDeviceUnit)
    : painter_(painter), palette_(palette), pixelsPerDeviceUnit_(std::max(pixelsPerDeviceUnit, 0.01)) {}

QtCanvas::Grid QtCanvas::grid() const {
    const QTransform t = painter_.deviceTransform();
    const double k = pixelsPerDeviceUnit_;
    return {t.m11() * k, t.m22() * k, t.dx() * k, t.dy() * k};
}

platform::Rect QtCanvas::seen(const platform::Rect& rect) const {
    const auto* engine = painter_.paintEngine();
    if (engine == nullptr || engine->type() != QPaintEngine::Raster) {
        return rect;
    }
    const QRectF device(0.0, 0.0, painter_.device()->width(), painter_.device()->height());
    const QRectF points = painter_.deviceTransform().inverted().mapRect(device);
    const QRectF seen = points.intersected(QRectF(rect.x, rect.y, rect.width, rect.height));
    return {seen.x(), seen.y(), seen.width(), seen.height()};
}

double QtCanvas::pixel() const {
    return 1.0 / std::max(grid().scaleY, 1e-6);
}

QRectF QtCanvas::snapped(const platform::Rect& rect) const {
    const Grid g = grid();
    if (g.scaleX <= 0.0 || g.scaleY <= 0.0) {
        return {rect.x, rect.y, rect.width, rect.height};
    }
    const Stretch x = snap(rect.x * g.scaleX + g.dx, rect.width * g.scaleX);
    const Stretch y = snap(rect.y * g.scaleY + g.dy, rect.height * g.scaleY);
    return {(x.from - g.dx) / g.scaleX, (y.from - g.dy) / g.scaleY, (x.to - x.from) / g.scaleX,
            (y.to - y.from) / g.scaleY};
}

void QtCanvas::save() {
    saved_.push_back({painter_.worldTransform(), false});
}

void QtCanvas::restore() {
    if (saved_.empty()) {
        return;
    }
    if (saved_.back().isPainters) {
        painter_.restore();
    } else {
        painter_.setWorldTransform(saved_.back().transform);
    }
    saved_.pop_back();
}

/// Saves the painter itself where so far its transformation was noted alone: what follows may change more.
void QtCanvas::savePainter() {
    if (saved_.empty() || saved_.back().isPainters) {
        return;
    }
    const QTransform present = painter_.worldTransform();
    for (Saved& saved : saved_) {
        if (!saved.isPainters) {
            painter_.setWorldTransform(saved.transform);
            painter_.save();
            saved.isPainters = true;
        }
    }
    painter_.setWorldTransform(present);
}

QPainter& QtCanvas::painter() {
    savePainter();
    return painter_;
}

void QtCanvas::translate(double dx, double dy) {
    painter_.translate(dx, dy);
}

void QtCanvas::clip(const platform::Rect& rect) {
    savePainter();
    painter_.setClipRect(snapped(rect), Qt::IntersectClip);
}

bool QtCanvas::cutsItself() const {
    const auto* engine = painter_.paintEngine();
    return engine != nullptr && engine->type() == QPaintEngine::SVG && painter_.hasClipping();
}

void QtCanvas::fillCut(const QPainterPath& path, const QColor& color) {
    painter_.fillPath(path.intersected(painter_.clipPath()), color);
}

/// As pixels, those outside the clip left out.
void QtCanvas::drawCut(const QtImage& picture, const QRectF& rect) {
    const QPainterPath clip = painter_.clipPath();
    if (clip.contains(rect)) {
        picture.draw(painter_, rect, palette_);
        return;
    }
    constexpr double kPixels = 3.0;  // a point
    constexpr double kMost = 8192.0;
    const double scale = std::min(kPixels, kMost / std::max({rect.width(), rect.height(), 1.0}));
    QImage pixels((rect.size() * scale).toSize().expandedTo({1, 1}), QImage::Format_ARGB32_Premultiplied);
    if (pixels.isNull()) {
        return;
    }
    pixels.fill(Qt::transparent);
    QPainter painter(&pixels);
    painter.setRenderHints(painter_.renderHints());
    painter.scale(pixels.width() / rect.width(), pixels.height() / rect.height());
    painter.translate(-rect.topLeft());
    // Masked rather than clipped: a clip has no smooth edge.
    picture.draw(painter, rect, palette_);
    QPainterPath outside;
    outside.addRect(rect);
    painter.setCompositionMode(QPainter::CompositionMode_DestinationOut);
    painter.fillPath(outside.subtracted(clip), Qt::black);
    painter.end();
    painter_.drawImage(rect, pixels);
}

void QtCanvas::fill(const platform::Rect& rect, const platform::Color& color) {
    if (color.isClear() || rect.width <= 0.0 || rect.height <= 0.0) {
        return;
    }
    if (cutsItself()) {
        QPainterPath path;
        path.addRect(snapped(rect));
        fillCut(path, palette_.resolve(color));
        return;
    }
    // The rectangle stands on whole pixels: smoothing its edges could only blur them by a rounding error.
    const bool smooth = painter_.testRenderHint(QPainter::Antialiasing);
    painter_.setRenderHint(QPainter::Antialiasing, false);
    painter_.fillRect(snapped(rect), palette_.resolve(color));
    painter_.setRenderHint(QPainter::Antialiasing, smooth);
}

QPointF QtCanvas::onBaseline(const QtTextLayout& text, platform::Point origin) const {
    const Grid g = grid();
    if (g.scaleY <= 0.0) {
        return {origin.x, origin.y};
    }
    const double baseline = text.lines().front().baseline;
    const double onDevice = (origin.y + baseline) * g.scaleY + g.dy;
    return {origin.x, (std::floor(onDevice + 0.5 + kSlack) - g.dy) / g.scaleY - baseline};
}

void QtCanvas::draw(const platform::TextLayout& text, platform::Point origin, const platform::Color& color) {
    const auto* layout = dynamic_cast<const QtTextLayout*>(&text);
    if (layout != nullptr && !layout->lines().empty()) {
        layout->draw(painter_, onBaseline(*layout, origin), palette_.resolve(color), palette_);
    }
}

void QtCanvas::drawHalo(const platform::TextLayout& text, platform::Point origin, const platform::Color& color,
                        double width) {
    const auto* layout = dynamic_cast<const QtTextLayout*>(&text);
    if (layout == nullptr || layout->lines().empty() || width <= 0.0) {
        return;
    }
    const QPen pen(palette_.resolve(color), width, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin);
    painter_.strokePath(layout->outline().translated(onBaseline(*layout, origin)), pen);
}

/// At its own size, whatever the rectangle's: texts are not stretched.
void QtCanvas::drawText(const platform::TextImage& image, const platform::Rect& rect) {
    const QRectF place = snapped(rect);
    const auto* engine = painter_.paintEngine();
    const bool isRaster = engine == nullptr || engine->type() == QPaintEngine::Raster;
    const auto* text = dynamic_cast<const QtTextImage*>(&image);
    if (isRaster && text != nullptr && text->drawPixels(painter_, place.topLeft(), grid().scaleY, palette_)) {
        return;
    }
    draw(image.layout(), {place.x(), place.y()}, platform::Color::ofRole(platform::ColorRole::StandardText));
}

void QtCanvas::draw(const platform::Image& image, const platform::Rect& rect) {
    if (const auto* text = dynamic_cast<const platform::TextImage*>(&image)) {
        drawText(*text, rect);
        return;
    }
    if (const auto* picture = dynamic_cast<const QtImage*>(&image); picture != nullptr && rect.width > 0.0) {
        if (cutsItself()) {
            drawCut(*picture, snapped(rect));
        } else {
            picture->draw(painter_, snapped(rect), palette_);
        }
    }
}

void QtCanvas::drawMoving(const platform::Image& image, const platform::Rect& rect) {
    if (const auto* picture = dynamic_cast<const QtImage*>(&image); picture != nullptr && rect.width > 0.0) {
        picture->drawMoving(painter_, {rect.x, rect.y, rect.width, rect.height}, palette_);
    }
}

namespace {

QPainterPath toQt(const platform::Path& path) {
    QPainterPath result;
    result.setFillRule(Qt::WindingFill);
    const auto point = [](platform::Point p) { return QPointF(p.x, p.y); };
    for (const auto& element : path.elements()) {
        switch (element.verb) {
            case platform::Path::Verb::Move:
                result.moveTo(point(element.end));
                break;
            case platform::Path::Verb::Line:
                result.lineTo(point(element.end));
                break;
            case platform::Path::Verb::Quad:
                result.quadTo(point(element.control1), point(element.end));
                break;
            case platform::Path::Verb::Cubic:
                result.cubicTo(point(element.control1), point(element.control2), point(element.end));
                break;
            case platform::Path::Verb::Close:
                result.closeSubpath();
                break;
        }
    }
    return result;
}

}  // namespace

void QtCanvas::fill(const platform::Path& path, const platform::Color& color) {
    if (color.isClear() || path.empty()) {
        return;
    }
    if (cutsItself()) {
        fillCut(toQt(path), palette_.resolve(color));
    } else {
        painter_.fillPath(toQt(path), palette_.resolve(color));
    }
}

void QtCanvas::stroke(const platform::Path& path, const platform::Color& color, const platform::Stroke& stroke) {
    if (!color.isClear() && !path.empty() && stroke.width > 0.0) {
        const QPen pen(palette_.resolve(color), stroke.width, Qt::SolidLine,
                       stroke.roundEnds ? Qt::RoundCap : Qt::FlatCap, Qt::RoundJoin);
        painter_.strokePath(toQt(path), pen);
    }
}

void QtCanvas::clip(const platform::Path& path) {
    savePainter();
    painter_.setClipPath(toQt(path), Qt::IntersectClip);
}

}  // namespace ktr::linux_
