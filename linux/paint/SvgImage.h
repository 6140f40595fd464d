#pragma once

#include <QByteArray>
#include <QSvgRenderer>
#include <memory>

#include "linux/paint/QtImage.h"

namespace ktr::linux_ {

/// A picture made of lines and areas. Main thread.
class SvgImage final : public QtImage {
  public:
    /// None when the source cannot be read or has no size.
    static std::shared_ptr<SvgImage> fromSource(const QByteArray& source);

    /// The source's own width and height, as points.
    platform::Size size() const override;
    void draw(QPainter& painter, const QRectF& rect, const Palette& palette) const override;

  private:
    SvgImage() = default;

    /// Rendering is not const to Qt, though it changes nothing that shows.
    mutable QSvgRenderer renderer_;
};

}  // namespace ktr::linux_
