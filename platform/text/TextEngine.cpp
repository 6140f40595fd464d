#include "platform/text/TextEngine.h"

namespace ktr::platform {

TextLayout::~TextLayout() = default;
TextEngine::~TextEngine() = default;

}  // namespace ktr::platform
