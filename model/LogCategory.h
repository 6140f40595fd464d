#pragma once

#include <memory>

#include "platform/base/Log.h"

namespace ktr {

/// The plugin's one log handle: subsystem is the plugin's bundle identifier, category "_". The same handle for as long
/// as a platform is installed. Never none: without a platform (deferred work that outlives the host's own) it is a
/// handle whose lines go nowhere. Any thread.
std::shared_ptr<const platform::Log> LogCategory_Unspecified();

/// Whether a line of this level would be kept: asked first where what the line says costs something. Main thread.
bool isLineWanted(platform::LogLevel level);

}  // namespace ktr
