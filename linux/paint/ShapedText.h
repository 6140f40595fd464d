#pragma once

#include <QPainterPath>
#include <QPointF>
#include <QRawFont>
#include <memory>
#include <optional>
#include <vector>

#include "linux/paint/BrokenText.h"
#include "linux/paint/FontChoice.h"
#include "linux/paint/Palette.h"
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
    ~ShapedText();
    ShapedText(const ShapedText&) = delete;
    ShapedText& operator=(const ShapedText&) = delete;

    /// The text broken into lines once more, in this thread.
    BrokenText shapedAgain() const;
    void draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const;
    /// The letters' outlines, from the origin; points. Glyphs that are pictures have none.
    QPainterPath outline() const;

  private:
    /// Glyphs of one font and one colour on one baseline, or each at a height of its own.
    struct GlyphRun {
        QRawFont font;
        int count = 0;
        /// Of `colors`; -1 for the colour that is drawn with.
        short color = -1;
        bool hasHeights = false;
        float y = 0.0F;
    };
    /// By run: the glyphs' x, their y where these differ, and their indexes, two in a word. In the recipe's units: a
    /// line is at most 32,000 points wide, and a float holds every 64th of a pixel of it.
    struct Glyphs {
        std::vector<GlyphRun> runs;
        std::unique_ptr<quint32[]> words;
        std::vector<std::optional<platform::Color>> colors;
    };

    static Glyphs glyphsOf(const BrokenText& broken);
    void drawGlyphs(QPainter& painter, const QColor& color, const Palette& palette) const;

    TextKey key_;
    FontChoice fonts_;
    double scale_;
    /// The main thread's; none until it draws what another thread shaped.
    mutable Glyphs glyphs_;
};

}  // namespace ktr::linux_
