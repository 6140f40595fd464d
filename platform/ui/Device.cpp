#include "platform/ui/Device.h"

namespace ktr::platform {

Device::~Device() = default;

}  // namespace ktr::platform
