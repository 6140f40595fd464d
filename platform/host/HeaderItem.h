#pragma once

#include <memory>
#include <string>

#include "platform/ui/Image.h"

namespace ktr::platform {

/// What the host puts above an answer.
class KTR_API HeaderItem : public Object {
  public:
    HeaderItem(std::string title, std::shared_ptr<Image> image) : title_(std::move(title)), image_(std::move(image)) {}
    const std::string& title() const { return title_; }
    /// May be none.
    const std::shared_ptr<Image>& image() const { return image_; }

  private:
    std::string title_;
    std::shared_ptr<Image> image_;
};

}  // namespace ktr::platform
