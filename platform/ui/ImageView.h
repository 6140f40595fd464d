#pragma once

#include <memory>

#include "platform/ui/Image.h"
#include "platform/ui/View.h"

namespace ktr::platform {

/// Shows an image, scaled to fill the view. Its content's size is the image's. Takes no touches. Main thread.
class KTR_API ImageView : public View {
  public:
    ImageView();
    std::shared_ptr<Image> image() const { return image_; }
    void setImage(std::shared_ptr<Image> image);
    IntrinsicSize intrinsicContentSize(double widthLimit) const override;

  protected:
    void draw(Canvas& canvas) const override;

  private:
    std::shared_ptr<Image> image_;
};

}  // namespace ktr::platform
