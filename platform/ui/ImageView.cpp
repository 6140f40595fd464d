#include "platform/ui/ImageView.h"

#include "platform/ui/Canvas.h"

namespace ktr::platform {

ImageView::ImageView() {
    setUserInteractionEnabled(false);
}

void ImageView::setImage(std::shared_ptr<Image> image) {
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

IntrinsicSize ImageView::intrinsicContentSize(double /*widthLimit*/) const {
    if (!image_) {
        return {};
    }
    return {image_->size().width, image_->size().height};
}

void ImageView::draw(Canvas& canvas) const {
    if (image_) {
        canvas.draw(*image_, bounds());
    }
}

}  // namespace ktr::platform
