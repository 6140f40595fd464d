#pragma once

#include "platform/base/Log.h"

namespace ktr::platform {

/// What stands around the plugin, by what its log lines are about: each area is a category of its own under the
/// subsystem "org.ktr.platform".
enum class LogArea { Account, Contacts, Host, Maps, Net, Paint, Positions, Preferences };

/// The area's log. Any thread.
KTR_API const Log& areaLog(LogArea area);

}  // namespace ktr::platform
