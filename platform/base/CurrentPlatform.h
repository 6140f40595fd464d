#pragma once

#include "platform/base/Api.h"

namespace ktr::platform {

class Platform;

/// The installed platform, or none, without a share in it: `Platform::installed` takes a lock and counts, and a row
/// asks dozens of times while it is filled. For a look that ends before anything could take the platform away. Main
/// thread, to which installing belongs.
KTR_API Platform* currentPlatform();

}  // namespace ktr::platform
