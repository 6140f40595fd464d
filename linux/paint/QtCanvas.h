#pragma once

#include <QPointF>
#include <QRectF>
#include <QTransform>
#include <vector>

#include "linux/paint/Palette.h"
#include "platform/text/TextImage.h"
#include "platform/ui/Canvas.h"

class QPainter;
class QPainterPath;

namespace ktr::linux_ {

class QtImage;
class QtTextLayout;

/// Paints views with a QPainter whose coordinates are points (its transformation, or its device's pixel ratio, makes
/// pixels of them). Fills, clips and images are snapped to device pixels by their edges, so that neighbours meet; what
/// is thinner than a pixel and a half is exactly one pixel thick. Baselines stand on whole pixels. Main thread.
class QtCanvas final : public platform::Canvas {
  public:
    /// The painter and the palette must outlive the canvas. `pixelsPerDeviceUnit` refines the grid of a vector device,
    /// whose units are not pixels: 2 snaps to halves of a unit.
    QtCanvas(QPainter& painter, const Palette& palette, double pixelsPerDeviceUnit = 1.0);

    void save() override;
    void restore() override;
    void translate(double dx, double dy) override;
    void clip(const platform::Rect& rect) override;
    void fill(const platform::Rect& rect, const platform::Color& color) override;
    void draw(const platform::TextLayout& text, platform::Point origin, const platform::Color& color) override;
    void draw(const platform::Image& image, const platform::Rect& rect) override;
    void drawMoving(const platform::Image& image, const platform::Rect& rect) override;
    void fill(const platform::Path& path, const platform::Color& color) override;
    void stroke(const platform::Path& path, const platform::Color& color, const platform::Stroke& stroke) override;
    void clip(const platform::Path& path) override;
    void drawHalo(const platform::TextLayout& text, platform::Point origin, const platform::Color& color,
                  double width) override;

    /// For what a host paints around the views.
    QPainter& painter();
    const Palette& palette() const { return palette_; }
    /// The rectangle that `rect` becomes on the grid of device pixels, in points.
    QRectF snapped(const platform::Rect& rect) const;
    /// What of `rect`, both in points, is on the device at all; all of it on a vector device.
    platform::Rect seen(const platform::Rect& rect) const;
    /// The size of a device pixel, points.
    double pixel() const;

  private:
    struct Grid {
        double scaleX = 1.0;
        double scaleY = 1.0;
        double dx = 0.0;
        double dy = 0.0;
    };
    Grid grid() const;
    void drawText(const platform::TextImage& image, const platform::Rect& rect);
    /// SVG files are written without clips: what is cut is cut before it is written.
    bool cutsItself() const;
    void fillCut(const QPainterPath& path, const QColor& color);
    void drawCut(const QtImage& picture, const QRectF& rect);
    /// A text's origin, moved so that its first baseline stands on a whole pixel.
    QPointF onBaseline(const QtTextLayout& text, platform::Point origin) const;
    void savePainter();

    /// Saving a painter costs as much as drawing a short text, and few views change more than the transformation.
    struct Saved {
        QTransform transform;
        bool isPainters = false;
    };

    QPainter& painter_;
    const Palette& palette_;
    double pixelsPerDeviceUnit_;
    std::vector<Saved> saved_;
};

}  // namespace ktr::linux_
