#include "platform/text/TextEngine.h"

#include "platform/text/TextImage.h"

namespace ktr::platform {

TextLayout::~TextLayout() = default;
TextEngine::~TextEngine() = default;

std::shared_ptr<TextImage> TextEngine::image(std::shared_ptr<const TextLayout> layout, const Size& size,
                                             double /*scale*/) {
    return std::make_shared<TextImage>(std::move(layout), size);
}

}  // namespace ktr::platform
