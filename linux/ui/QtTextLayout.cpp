#include "linux/ui/QtTextLayout.h"

#include <QPainter>
#include <algorithm>

namespace ktr::linux_ {

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

QPainterPath QtTextLayout::outline() const {
    QPainterPath path;
    path.setFillRule(Qt::WindingFill);
    for (const Piece& piece : pieces_) {
        path.addPath(piece.shaped->outline().translated(piece.offset));
    }
    return path;
}

}  // namespace ktr::linux_
