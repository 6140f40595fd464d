#pragma once

#include <memory>

#include "platform/ui/Image.h"
#include "platform/ui/View.h"

namespace ktr::platform {

/// How an image fills its view: scaled, or at its own size in a corner.
enum class ContentMode { ScaleToFill, TopLeft, TopRight };

/// Shows an image. Its content's size is the image's. Takes no touches. Main thread.
class KTR_API ImageView : public View {
  public:
    ImageView();
    std::shared_ptr<Image> image() const { return image_; }
    void setImage(std::shared_ptr<Image> image);
    /// An image is being made for the view: what stands around it may wait for it. Ends with the next `setImage`.
    bool isAwaitingImage() const { return isAwaitingImage_; }
    void awaitImage() { isAwaitingImage_ = true; }
    ContentMode contentMode() const { return contentMode_; }
    void setContentMode(ContentMode mode);
    IntrinsicSize intrinsicContentSize(double widthLimit) const override;

  protected:
    void draw(Canvas& canvas) const override;

  private:
    std::shared_ptr<Image> image_;
    ContentMode contentMode_ = ContentMode::ScaleToFill;
    bool isAwaitingImage_ = false;
};

}  // namespace ktr::platform
