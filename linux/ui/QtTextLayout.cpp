#include "linux/ui/QtTextLayout.h"

#include <QGlyphRun>
#include <QPainter>
#include <algorithm>

namespace ktr::linux_ {

void ShapedText::draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const {
    const std::lock_guard lock(mutex_);
    painter.save();
    painter.translate(origin);
    painter.scale(scale_, scale_);
    painter.setRenderHint(QPainter::TextAntialiasing);
    for (int i = 0; i < lines_; ++i) {
        const QTextLine line = layout_->lineAt(i);
        painter.setPen(color);
        if (colors_.empty()) {
            line.draw(&painter, QPointF(0, 0));
            continue;
        }
        const int end = line.textStart() + line.textLength();
        for (const ColorRange& range : colors_) {
            const int from = std::max(range.start, line.textStart());
            const int to = std::min(range.start + range.length, end);
            painter.setPen(range.color ? palette.resolve(*range.color) : color);
            for (const QGlyphRun& run : from < to ? line.glyphRuns(from, to - from) : QList<QGlyphRun>()) {
                painter.drawGlyphRun(QPointF(0, 0), run);
            }
        }
    }
    painter.restore();
}

QtTextLayout::QtTextLayout(std::vector<Piece> pieces, std::vector<Line> lines, double padding, bool truncated)
    : pieces_(std::move(pieces)), lines_(std::move(lines)), truncated_(truncated) {
    if (lines_.empty()) {
        return;
    }
    double left = lines_.front().box.x;
    double right = lines_.front().box.maxX();
    double top = lines_.front().box.y;
    double bottom = lines_.front().box.maxY();
    for (const Line& line : lines_) {
        left = std::min(left, line.box.x);
        right = std::max(right, line.box.maxX());
        top = std::min(top, line.box.y);
        bottom = std::max(bottom, line.box.maxY());
    }
    usedSize_ = {right - left + 2.0 * padding, bottom - top};
}

void QtTextLayout::draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const {
    for (const Piece& piece : pieces_) {
        piece.shaped->draw(painter, origin + piece.offset, color, palette);
    }
}

}  // namespace ktr::linux_
