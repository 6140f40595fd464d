#pragma once

#include <QPainterPath>
#include <QPointF>
#include <QRawFont>
#include <QTextLayout>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "linux/ui/Palette.h"
#include "linux/ui/ShapeRecipe.h"

class QPainter;

namespace ktr::linux_ {

/// A shaped text with its lines in place. Shared between layouts that differ in their alignment only. Any thread may
/// draw it: the main thread keeps what was shaped, others shape again for each drawing.
class ShapedText {
  public:
    /// Part of the text in a colour; none takes the colour that is drawn with.
    struct ColorRange {
        int start = 0;
        int length = 0;
        std::optional<platform::Color> color;
    };

    /// Glyphs are shaped at whole sizes; `scale` takes the recipe's units to points. `colors` is empty for a text in
    /// one colour, else it covers the text. `layout` is what this thread has shaped of the recipe with these lines (it
    /// may hold more lines behind them, which are not drawn); it is not kept.
    ShapedText(ShapeRecipe recipe, std::vector<ShapeRecipe::Line> lines, double scale, std::vector<ColorRange> colors,
               const QTextLayout& layout);
    ~ShapedText();
    ShapedText(const ShapedText&) = delete;
    ShapedText& operator=(const ShapedText&) = delete;

    const ShapeRecipe& recipe() const { return recipe_; }
    const std::vector<ShapeRecipe::Line>& lines() const { return lines_; }
    double scale() const { return scale_; }
    void draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const;
    /// The letters' outlines, from the origin; points. Glyphs that are pictures have none.
    QPainterPath outline() const;

  private:
    /// Glyphs of one font and one colour.
    struct GlyphRun {
        QRawFont font;
        int count = 0;
        /// Of colors_; -1 for the colour that is drawn with.
        int color = -1;
    };
    /// What the main thread has shaped: a tenth of a QTextLayout. In the recipe's units.
    struct Glyphs {
        std::vector<GlyphRun> runs;
        std::vector<quint32> indexes;
        std::vector<std::pair<float, float>> positions;
    };

    void drawLines(QPainter& painter, const QTextLayout& layout, const QColor& color, const Palette& palette) const;
    void drawGlyphs(QPainter& painter, const QColor& color, const Palette& palette) const;
    std::shared_ptr<const Glyphs> glyphsOf(const QTextLayout& layout) const;

    ShapeRecipe recipe_;
    std::vector<ShapeRecipe::Line> lines_;
    double scale_;
    std::vector<ColorRange> colors_;
    /// The main thread's; none until it draws what another thread shaped.
    mutable std::shared_ptr<const Glyphs> glyphs_;
};

}  // namespace ktr::linux_
