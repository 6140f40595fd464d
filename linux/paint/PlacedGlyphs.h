#pragma once

#include <QPointF>
#include <QRawFont>
#include <QVarLengthArray>
#include <memory>
#include <optional>
#include <vector>

#include "linux/paint/Palette.h"

class QPainter;

namespace ktr::linux_ {

/// Glyphs where they stand, in the units that they were shaped in (pixels of their fonts). Fonts belong to the thread
/// that loaded them: the main thread makes, draws and drops these.
class PlacedGlyphs {
  public:
    class Maker;

    bool empty() const { return runs_.empty(); }
    /// Runs without a colour of their own take `color`.
    void draw(QPainter& painter, const QColor& color, const Palette& palette) const;

  private:
    /// Glyphs of one font and one colour on one baseline, or each at a height of its own.
    struct Run {
        QRawFont font;
        int count = 0;
        /// Of `colors_`; -1 for the colour that is drawn with.
        short color = -1;
        bool hasHeights = false;
        float y = 0.0F;
    };

    std::vector<Run> runs_;
    /// By run: the glyphs' x, their y where these differ, and their indexes, two in a word. A line is at most 32,000
    /// points wide, and a float holds every 64th of a pixel of it.
    std::unique_ptr<quint32[]> words_;
    /// None for a text in one colour, as nearly all are.
    std::unique_ptr<std::vector<std::optional<platform::Color>>> colors_;
};

/// Takes runs in the order in which they are drawn. Main thread.
class PlacedGlyphs::Maker {
  public:
    /// Gives the colour's number for `add`; none is the colour that is drawn with, too.
    int addColor(std::optional<platform::Color> color);
    /// Glyphs of one font; -1 is the colour that is drawn with. No glyphs are no run.
    void add(const QRawFont& font, const quint32* indexes, const QPointF* positions, int count, int color = -1);
    PlacedGlyphs made();

  private:
    PlacedGlyphs glyphs_;
    QVarLengthArray<quint32, 256> words_;
};

}  // namespace ktr::linux_
