#pragma once

#include <QPointF>
#include <QString>
#include <QTextLayout>
#include <memory>
#include <vector>

#include "linux/paint/FontChoice.h"

namespace ktr::linux_ {

/// What a text is shaped from. Fonts that one thread has loaded end with it, so that what is to be drawn anywhere is
/// kept as its recipe and shaped where it is drawn. A value; any thread.
struct ShapeRecipe {
    /// Part of the text in another font.
    struct Range {
        qsizetype start = 0;
        qsizetype length = 0;
        FontSpec font;
    };
    /// A line: the width it was broken at and where it stands. In the recipe's units, pixels of its fonts.
    struct Line {
        double width = 0.0;
        QPointF position;
    };

    QString text;
    FontSpec font;
    std::vector<Range> ranges;
    Qt::LayoutDirection direction = Qt::LeftToRight;
    bool wrap = false;
    /// Lines may end between any two graphemes, for a text without places to break at.
    bool wrapAnywhere = false;

    /// Ready for its lines.
    std::unique_ptr<QTextLayout> layout() const;
    /// With these lines broken and in place; text beyond the last one is not laid out.
    std::unique_ptr<QTextLayout> layout(const std::vector<Line>& lines) const;
};

}  // namespace ktr::linux_
