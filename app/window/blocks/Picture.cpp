#include "app/window/blocks/Picture.h"

#include <QPainter>

namespace ktr::app {

void Picture::setImage(std::shared_ptr<const linux_::QtImage> image) {
    image_ = std::move(image);
    update();
}

void Picture::paintEvent(QPaintEvent*) {
    if (image_) {
        QPainter painter(this);
        painter.setRenderHint(QPainter::Antialiasing);
        image_->draw(painter, QRectF(mirrored(QRectF(0, 0, side_, side_))), colors());
    }
}

}  // namespace ktr::app
