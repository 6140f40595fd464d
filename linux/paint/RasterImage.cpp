#include "linux/paint/RasterImage.h"

#include <QPainter>
#include <algorithm>
#include <cmath>

namespace ktr::linux_ {

void RasterImage::draw(QPainter& painter, const QRectF& rect, const Palette& /*palette*/) const {
    const double scale = pixelsPerUnit(painter);
    const QSize wanted(static_cast<int>(std::clamp(std::round(rect.width() * scale), 1.0, 32000.0)),
                       static_cast<int>(std::clamp(std::round(rect.height() * scale), 1.0, 32000.0)));
    painter.save();
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    if (wanted.width() < pixels_.width() && wanted.height() < pixels_.height()) {
        if (scaled_.size() != wanted) {
            scaled_ = pixels_.scaled(wanted, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
        }
        painter.drawImage(rect, scaled_);
    } else {
        painter.drawImage(rect, pixels_);
    }
    painter.restore();
}

void RasterImage::drawMoving(QPainter& painter, const QRectF& rect, const Palette& /*palette*/) const {
    painter.save();
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    painter.drawImage(rect, pixels_);
    painter.restore();
}

}  // namespace ktr::linux_
