#include "platform/ui/Canvas.h"

namespace ktr::platform {

Canvas::~Canvas() = default;

}  // namespace ktr::platform
