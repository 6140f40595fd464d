#pragma once

#include <QByteArray>
#include <QSvgRenderer>
#include <memory>

#include "linux/paint/QtImage.h"

namespace ktr::linux_ {

/// A picture made of lines and areas, for the images that come with the program: data from elsewhere is decoded by
/// ImageDecoder, which knows no such pictures. Main thread.
class SvgImage final : public QtImage {
  public:
    /// More than any of the program's own drawings.
    static constexpr qsizetype kMostBytes = qsizetype{1} << 20;
    static constexpr int kMostSide = 8192;

    /// None when the source cannot be read, has no size, is beyond the caps, or is more than a drawing by itself: with
    /// a document type, another picture in it, a script, or a reference to what is outside of it (none is followed).
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
