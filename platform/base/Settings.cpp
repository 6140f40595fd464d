#include "platform/base/DeviceInformation.h"
#include "platform/base/Preferences.h"

namespace ktr::platform {

DeviceInformation::~DeviceInformation() = default;
DeviceLock::~DeviceLock() = default;
GeographicSettings::~GeographicSettings() = default;
Preferences::~Preferences() = default;

}  // namespace ktr::platform
