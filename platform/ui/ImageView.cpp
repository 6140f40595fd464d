#include "platform/ui/ImageView.h"

#include "platform/ui/Canvas.h"

namespace ktr::platform {

ImageView::ImageView() {
    setUserInteractionEnabled(false);
}

void ImageView::setImage(std::shared_ptr<Image> image) {
    isAwaitingImage_ = false;
    if (image == image_) {
        return;
    }
    const bool sameSize = image && image_ && image->size() == image_->size();
    image_ = std::move(image);
    if (!sameSize) {
        invalidateIntrinsicContentSize();
    }
    setNeedsDisplay();
}

void ImageView::setContentMode(ContentMode mode) {
    if (mode != contentMode_) {
        contentMode_ = mode;
        setNeedsDisplay();
    }
}

IntrinsicSize ImageView::intrinsicContentSize(double /*widthLimit*/) const {
    if (!image_) {
        return {};
    }
    return {image_->size().width, image_->size().height};
}

void ImageView::draw(Canvas& canvas) const {
    if (!image_) {
        return;
    }
    if (contentMode_ == ContentMode::ScaleToFill) {
        canvas.draw(*image_, bounds());
        return;
    }
    const Size size = image_->size();
    const double x = contentMode_ == ContentMode::TopRight ? bounds().width - size.width : 0.0;
    canvas.draw(*image_, {x, 0.0, size.width, size.height});
}

}  // namespace ktr::platform
