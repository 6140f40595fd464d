#include "platform/ui/Image.h"

namespace ktr::platform {

ImageSource::~ImageSource() = default;

}  // namespace ktr::platform
