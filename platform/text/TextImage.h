#pragma once

#include <memory>

#include "platform/text/TextEngine.h"
#include "platform/ui/Image.h"

namespace ktr::platform {

/// A picture of a text. It keeps the text as it was laid out, so that it is sharp at any scale: a canvas draws it at
/// its own size, whatever it is asked to fill. What the text leaves free is clear; runs without a colour of their own
/// take the standard text colour. Immutable to its users.
class KTR_API TextImage : public Image {
  public:
    /// The layout's container lies at the picture's top left corner. Never none.
    TextImage(std::shared_ptr<const TextLayout> layout, const Size& size) : layout_(std::move(layout)), size_(size) {}

    Size size() const override { return size_; }
    const TextLayout& layout() const { return *layout_; }

  private:
    std::shared_ptr<const TextLayout> layout_;
    Size size_;
};

}  // namespace ktr::platform
