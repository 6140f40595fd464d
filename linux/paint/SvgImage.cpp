#include "linux/paint/SvgImage.h"

#include <QPainter>

namespace ktr::linux_ {

std::shared_ptr<SvgImage> SvgImage::fromSource(const QByteArray& source) {
    auto image = std::shared_ptr<SvgImage>(new SvgImage);
    if (!image->renderer_.load(source) || image->renderer_.defaultSize().isEmpty()) {
        return nullptr;
    }
    return image;
}

platform::Size SvgImage::size() const {
    const QSize size = renderer_.defaultSize();
    return {static_cast<double>(size.width()), static_cast<double>(size.height())};
}

void SvgImage::draw(QPainter& painter, const QRectF& rect, const Palette& /*palette*/) const {
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    renderer_.render(&painter, rect);
    painter.restore();
}

}  // namespace ktr::linux_
