#pragma once

#include <QTextLayout>
#include <memory>
#include <optional>
#include <vector>

#include "linux/paint/ShapeRecipe.h"
#include "platform/text/TextEngine.h"

namespace ktr::linux_ {

/// A text as it was broken into lines, with all that was needed for it. Of the thread that made it.
struct BrokenText {
    /// Part of a piece in a colour; none takes the colour that is drawn with.
    struct ColorRange {
        int start = 0;
        int length = 0;
        std::optional<platform::Color> color;
    };
    /// Lines of one shaping, in place. The layout may hold more lines behind them, which are not drawn.
    struct Piece {
        ShapeRecipe recipe;
        std::unique_ptr<QTextLayout> layout;
        int lines = 0;
        /// Empty for a text in one colour, else it covers the text.
        std::vector<ColorRange> colors;
    };

    std::vector<Piece> pieces;
    std::vector<platform::TextLayout::Line> lines;
    bool isTruncated = false;
    /// Glyphs are shaped at whole sizes; this takes the recipes' units to points.
    double scale = 1.0;
};

}  // namespace ktr::linux_
