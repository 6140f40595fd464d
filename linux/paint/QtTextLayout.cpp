#include "linux/paint/QtTextLayout.h"

#include <QPainter>
#include <algorithm>

namespace ktr::linux_ {

QtTextLayout::QtTextLayout(std::shared_ptr<const ShapedText> shaped, double offset, std::vector<Line> lines,
                           double padding, bool truncated)
    : shaped_(std::move(shaped)), offset_(offset), lines_(std::move(lines)), truncated_(truncated) {
    lines_.shrink_to_fit();
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
    if (shaped_) {
        shaped_->draw(painter, origin + QPointF(offset_, 0.0), color, palette);
    }
}

QPainterPath QtTextLayout::outline() const {
    return shaped_ ? shaped_->outline().translated(offset_, 0.0) : QPainterPath();
}

}  // namespace ktr::linux_
