#pragma once

#include <QImage>
#include <QPointF>
#include <atomic>
#include <memory>

#include "linux/paint/Palette.h"
#include "platform/text/TextImage.h"

class QPainter;

namespace ktr::linux_ {

/// A picture of a text with its pixels kept: made ahead, at one scale and in one appearance's colours. What is
/// painted at another scale or in other colours is drawn from the text, which looks the same, and the pixels for it are
/// made in the background meanwhile. Made on any thread, drawn on the main thread.
class QtTextImage final : public platform::TextImage {
  public:
    /// The colours that a text image was painted in last: what is made next will be painted in them too. Any thread.
    using LastPalette = std::atomic<const Palette*>;

    /// Makes the pixels. A picture beyond some million of them keeps the text alone.
    QtTextImage(std::shared_ptr<const platform::TextLayout> layout, const platform::Size& size, double scale,
                std::shared_ptr<LastPalette> lastPalette);

    /// Paints the pixels, when they were made for `scale` device pixels a point and for these colours; else says so
    /// and has them made. `topLeft` stands on a whole pixel.
    bool drawPixels(QPainter& painter, QPointF topLeft, double scale, const Palette& palette) const;

  private:
    /// Null: no pixels were made.
    struct Pixels {
        QImage image;
        double scale = 0.0;
        const Palette* palette = nullptr;
    };
    Pixels make(double scale, const Palette& palette) const;
    void makeInBackground(double scale, const Palette& palette) const;

    std::shared_ptr<LastPalette> lastPalette_;
    /// The main thread's once the image has been handed over.
    mutable Pixels pixels_;
    /// What was asked for last.
    mutable Pixels wanted_;
};

}  // namespace ktr::linux_
