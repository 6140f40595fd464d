#pragma once

#include <QImage>

#include "linux/paint/QtImage.h"

namespace ktr::linux_ {

/// A picture made of pixels. Main thread.
class RasterImage final : public QtImage {
  public:
    /// `size` in points. The pixels must not be null.
    RasterImage(QImage pixels, platform::Size size) : pixels_(std::move(pixels)), size_(size) {}

    platform::Size size() const override { return size_; }
    void draw(QPainter& painter, const QRectF& rect, const Palette& palette) const override;
    void drawMoving(QPainter& painter, const QRectF& rect, const Palette& palette) const override;

  private:
    QImage pixels_;
    platform::Size size_;
    /// The pixels at the size they were drawn at last: scaling down well costs more than drawing.
    mutable QImage scaled_;
};

}  // namespace ktr::linux_
