#pragma once

#include <memory>

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"
#include "platform/text/TextEngine.h"
#include "platform/ui/Color.h"
#include "platform/ui/Image.h"
#include "platform/ui/Path.h"

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
    /// The same for a picture that moves: not snapped, so that it glides.
    virtual void drawMoving(const Image& image, const Rect& rect) = 0;
    /// Outlines are drawn where they are, with smooth edges: never snapped. Overlapping parts count once.
    virtual void fill(const Path& path, const Color& color) = 0;
    virtual void stroke(const Path& path, const Color& color, const Stroke& stroke) = 0;
    virtual void clip(const Path& path) = 0;
    /// Widens a text's letters by half of `width` to every side, to be drawn under them: what keeps words legible on a
    /// picture. The same place as `draw` gives them.
    virtual void drawHalo(const TextLayout& text, Point origin, const Color& color, double width) = 0;
};

}  // namespace ktr::platform
