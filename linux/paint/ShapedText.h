#pragma once

#include <QPainterPath>
#include <QPointF>
#include <memory>

#include "linux/paint/BrokenText.h"
#include "linux/paint/FontChoice.h"
#include "linux/paint/Palette.h"
#include "linux/paint/PlacedGlyphs.h"
#include "linux/paint/TextKey.h"

class QPainter;

namespace ktr::linux_ {

/// The glyphs of a text in its container, in place. Shared between layouts that differ in their alignment only. Any
/// thread may draw it: the main thread keeps the glyphs, since fonts that a thread has loaded end with it; others shape
/// again for each drawing.
class ShapedText {
  public:
    /// `broken` is what became of the key's text with these fonts; of it only glyphs are kept.
    ShapedText(TextKey key, FontChoice fonts, const BrokenText& broken);
    /// Of glyphs that were placed in the main thread, in units that `scale` takes to points.
    ShapedText(TextKey key, FontChoice fonts, double scale, PlacedGlyphs glyphs);
    ~ShapedText();
    ShapedText(const ShapedText&) = delete;
    ShapedText& operator=(const ShapedText&) = delete;

    /// Whether this is the main thread.
    static bool keepsGlyphsHere();
    /// The text broken into lines once more, in this thread.
    BrokenText shapedAgain() const;
    void draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const;
    /// The letters' outlines, from the origin; points. Glyphs that are pictures have none.
    QPainterPath outline() const;

  private:
    static PlacedGlyphs glyphsOf(const BrokenText& broken);

    TextKey key_;
    FontChoice fonts_;
    double scale_;
    /// The main thread's; none until it draws what another thread shaped.
    mutable PlacedGlyphs glyphs_;
};

}  // namespace ktr::linux_
