#pragma once

#include <QRectF>

#include "linux/paint/Palette.h"
#include "platform/ui/Image.h"

class QPainter;

namespace ktr::linux_ {

/// A picture that a QtCanvas draws. Immutable to its users. Main thread.
class QtImage : public platform::Image {
  public:
    /// Fills `rect` of the painter's coordinates, at the best resolution that the painter's device shows. `palette`
    /// decides between the variants of an image that differs by appearance.
    virtual void draw(QPainter& painter, const QRectF& rect, const Palette& palette) const = 0;
    /// The same for one frame of a movement: the next one may have another size, so that nothing is kept for this one.
    virtual void drawMoving(QPainter& painter, const QRectF& rect, const Palette& palette) const {
        draw(painter, rect, palette);
    }

  protected:
    /// Device pixels a unit of the painter's coordinates; for vector output a resolution that prints well.
    static double pixelsPerUnit(const QPainter& painter);
};

}  // namespace ktr::linux_
