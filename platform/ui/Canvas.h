#pragma once

#include <memory>

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"
#include "platform/text/TextEngine.h"
#include "platform/ui/Color.h"
#include "platform/ui/Image.h"

namespace ktr::platform {

/// What views paint on. Points; frames of any fraction are snapped to device pixels here and nowhere else. Colours of a
/// role are resolved here. Main thread.
class KTR_API Canvas {
  public:
    virtual ~Canvas();
    virtual void save() = 0;
    virtual void restore() = 0;
    virtual void translate(double dx, double dy) = 0;
    virtual void clip(const Rect& rect) = 0;
    /// Nothing for a clear colour. A rectangle of a visible extent is never snapped away: it keeps at least a device
    /// pixel.
    virtual void fill(const Rect& rect, const Color& color) = 0;
    /// Draws a text that the installed text engine laid out, its container's top left corner at `origin`; runs without
    /// a colour of their own take `color`.
    virtual void draw(const TextLayout& text, Point origin, const Color& color) = 0;
    virtual void draw(const Image& image, const Rect& rect) = 0;
};

}  // namespace ktr::platform
